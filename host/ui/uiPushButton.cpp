#include "uiPushButton.h"

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
    RCShdPtr<UiPushButton> const button = UiPushButton::create(parent, element.getName().c_str(), nullptr);
    if (std::optional<std::string> const text = element.takeLabelString())
        button->getLabel().setString(text->c_str());
    button->setAlign(element.takeAlign(NtAlign::Center));
}

UiWidgetKind const registered("PushButton", &build);

} // namespace

UiPushButton::UiPushButton(std::string name) : UiPeeredWidget(std::move(name)), _label([this] { showLabel(); }) {}

void UiPushButton::showLabel()
{
    if (NtPushButton* const peer = getPeer())
        peer->setText(_label.getString());
}

RCShdPtr<UiPushButton> UiPushButton::create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*)
{
    RCShdPtr<UiPushButton> button(new UiPushButton(name));
    parent->addChild(button);
    return button;
}

void UiPushButton::setAlign(NtAlign align)
{
    requireUiThread();
    _align = align;
    if (NtPushButton* const peer = getPeer())
        peer->setAlign(align);
}

void UiPushButton::press()
{
    RCShdPtr<UiPushButton> const self(this);
    if (takesInput())
        fire(PiWidget::Activate);
}

void UiPushButton::showState(NtPushButton& peer)
{
    peer.setText(_label.getString());
    peer.setAlign(_align);
}

} // namespace Kv
