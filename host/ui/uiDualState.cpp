#include "uiDualState.h"

#include "ntPlatform.h"
#include "uiContainer.h"
#include "uiWidgetElement.h"

#include <utility>

namespace Kv
{

UiDualState::UiDualState(std::string name) : UiWidget(std::move(name)) {}

RCShdPtr<UiDualState> UiDualState::create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*)
{
    RCShdPtr<UiDualState> toggle(new UiDualState(name));
    parent->addChild(toggle);
    return toggle;
}

void UiDualState::build(RCShdPtr<UiContainer> const& parent, UiWidgetElement& element)
{
    RCShdPtr<UiDualState> const toggle = create(parent, element.getName().c_str(), nullptr);
    toggle->setConstraint(element.getConstraint());
    element.takeAlign(NtAlign::Left);
    if (std::optional<int> const state = element.takeInt("State"))
        toggle->setState(*state != 0, false);
}

RttiType const& UiDualState::getClassType()
{
    return RttiGenType1<UiDualState, UiWidget>::getInstance();
}

RttiType const& UiDualState::getRttiType() const
{
    return getClassType();
}

bool UiDualState::getState() const
{
    return _state;
}

void UiDualState::setState(bool state, bool notify)
{
    requireUiThread();
    RCShdPtr<UiDualState> const self(this);
    _state = state;
    if (_native)
        _native->setState(state);
    if (notify)
        fire(PiWidget::State);
}

void UiDualState::onToggled(bool state)
{
    RCShdPtr<UiDualState> const self(this);
    if (!takesInput())
        return;
    _state = state;
    fire(PiWidget::State);
    fire(PiWidget::Activate);
}

std::unique_ptr<NtPeer> UiDualState::createPeer(NtPlatform& platform, NtContainer& parent)
{
    std::unique_ptr<NtToggle> peer = platform.createToggle(parent, getName(), *this);
    peer->setState(_state);
    _native = peer.get();
    return peer;
}

void UiDualState::dropPeer()
{
    _native = nullptr;
    UiWidget::dropPeer();
}

} // namespace Kv
