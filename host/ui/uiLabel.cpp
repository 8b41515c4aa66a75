#include "uiLabel.h"

#include "ntPlatform.h"
#include "uiContainer.h"
#include "uiWidgetElement.h"

#include <utility>

namespace Kv
{

UiLabel::UiLabel(std::string name) : UiWidget(std::move(name)), _label([this] { showLabel(); }) {}

void UiLabel::showLabel()
{
    if (_native)
        _native->setText(_label.getString());
}

RCShdPtr<UiLabel> UiLabel::create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*)
{
    RCShdPtr<UiLabel> label(new UiLabel(name));
    parent->addChild(label);
    return label;
}

void UiLabel::build(RCShdPtr<UiContainer> const& parent, UiWidgetElement& element)
{
    RCShdPtr<UiLabel> const label = create(parent, element.getName().c_str(), nullptr);
    label->setConstraint(element.getConstraint());
    if (std::optional<std::string> const text = element.takeLabelString())
        label->getLabel().setString(text->c_str());
    label->setAlign(element.takeAlign(NtAlign::Left));
}

RttiType const& UiLabel::getClassType()
{
    return RttiGenType1<UiLabel, UiWidget>::getInstance();
}

RttiType const& UiLabel::getRttiType() const
{
    return getClassType();
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
    if (_native)
        _native->setAlign(align);
}

std::unique_ptr<NtPeer> UiLabel::createPeer(NtPlatform& platform, NtContainer& parent)
{
    std::unique_ptr<NtLabel> peer = platform.createLabel(parent, getName());
    peer->setText(_label.getString());
    peer->setAlign(_align);
    _native = peer.get();
    return peer;
}

void UiLabel::dropPeer()
{
    _native = nullptr;
    UiWidget::dropPeer();
}

} // namespace Kv
