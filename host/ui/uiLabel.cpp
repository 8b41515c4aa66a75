#include "uiLabel.h"

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
    RCShdPtr<UiLabel> const label = UiLabel::create(parent, element.getName().c_str(), nullptr);
    if (std::optional<std::string> const text = element.takeLabelString())
        label->getLabel().setString(text->c_str());
    label->setAlign(element.takeAlign(NtAlign::Left));
}

UiWidgetKind const registered("Label", &build);

} // namespace

UiLabel::UiLabel(std::string name) : UiPeeredWidget(std::move(name)), _label([this] { showLabel(); }) {}

void UiLabel::showLabel()
{
    if (NtLabel* const peer = getPeer())
        peer->setText(_label.getString());
}

RCShdPtr<UiLabel> UiLabel::create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*)
{
    RCShdPtr<UiLabel> label(new UiLabel(name));
    parent->addChild(label);
    return label;
}

int UiLabel::getLeastWidth() const
{
    return 0;
}

UiString& UiLabel::getLabel()
{
    return _label;
}

void UiLabel::setAlign(NtAlign align)
{
    requireUiThread();
    _align = align;
    if (NtLabel* const peer = getPeer())
        peer->setAlign(align);
}

void UiLabel::showState(NtLabel& peer)
{
    peer.setText(_label.getString());
    peer.setAlign(_align);
}

} // namespace Kv
