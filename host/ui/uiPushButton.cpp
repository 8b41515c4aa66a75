#include "uiPushButton.h"

#include "ntPlatform.h"
#include "uiContainer.h"
#include "uiWidgetElement.h"

#include <utility>

namespace Kv
{

UiPushButton::UiPushButton(std::string name) : UiWidget(std::move(name)), _label([this] { showLabel(); }) {}

void UiPushButton::showLabel()
{
    if (_native)
        _native->setText(_label.getString());
}

RCShdPtr<UiPushButton> UiPushButton::create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*)
{
    RCShdPtr<UiPushButton> button(new UiPushButton(name));
    parent->addChild(button);
    return button;
}

void UiPushButton::build(RCShdPtr<UiContainer> const& parent, UiWidgetElement& element)
{
    RCShdPtr<UiPushButton> const button = create(parent, element.getName().c_str(), nullptr);
    button->setConstraint(element.getConstraint());
    if (std::optional<std::string> const text = element.takeLabelString())
        button->getLabel().setString(text->c_str());
    button->setAlign(element.takeAlign(NtAlign::Center));
}

RttiType const& UiPushButton::getClassType()
{
    return RttiGenType1<UiPushButton, UiWidget>::getInstance();
}

RttiType const& UiPushButton::getRttiType() const
{
    return getClassType();
}

void UiPushButton::setAlign(NtAlign align)
{
    requireUiThread();
    _align = align;
    if (_native)
        _native->setAlign(align);
}

void UiPushButton::press()
{
    RCShdPtr<UiPushButton> const self(this);
    if (takesInput())
        fire(PiWidget::Activate);
}

std::unique_ptr<NtPeer> UiPushButton::createPeer(NtPlatform& platform, NtContainer& parent)
{
    std::unique_ptr<NtPushButton> peer = platform.createPushButton(parent, getName(), *this);
    peer->setText(_label.getString());
    peer->setAlign(_align);
    _native = peer.get();
    return peer;
}

void UiPushButton::dropPeer()
{
    _native = nullptr;
    UiWidget::dropPeer();
}

} // namespace Kv
