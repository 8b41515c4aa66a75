#include "uiDualState.h"

#include "uiContainer.h"
#include "uiWidgetElement.h"
#include "uiWidgetFactory.h"

#include <utility>

namespace Kv
{

namespace
{

void build(RCShdPtr<UiContainer> const& parent, UiWidgetElement& element)
{
    RCShdPtr<UiDualState> const toggle = UiDualState::create(parent, element.getName().c_str(), nullptr);
    element.takeAlign(NtAlign::Left);
    if (std::optional<int> const state = element.takeInt("State"))
        toggle->setState(*state != 0, false);
}

UiWidgetKind const registered("ToggleButton", &build);

} // namespace

UiDualState::UiDualState(std::string name) : UiPeeredWidget(std::move(name)) {}

RCShdPtr<UiDualState> UiDualState::create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*)
{
    RCShdPtr<UiDualState> toggle(new UiDualState(name));
    parent->addChild(toggle);
    return toggle;
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
    if (NtToggle* const peer = getPeer())
        peer->setState(state);
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

void UiDualState::showState(NtToggle& peer)
{
    peer.setState(_state);
}

} // namespace Kv
