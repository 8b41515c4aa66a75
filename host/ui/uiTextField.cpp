#include "uiTextField.h"

#include "ntPlatform.h"
#include "text/liStringUtil.h"
#include "uiContainer.h"
#include "uiWidgetElement.h"

#include <utility>

namespace Kv
{

UiTextField::UiTextField(std::string name) : UiWidget(std::move(name)) {}

RCShdPtr<UiTextField> UiTextField::create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*)
{
    RCShdPtr<UiTextField> field(new UiTextField(name));
    parent->addChild(field);
    return field;
}

void UiTextField::build(RCShdPtr<UiContainer> const& parent, UiWidgetElement& element)
{
    RCShdPtr<UiTextField> const field = create(parent, element.getName().c_str(), nullptr);
    field->setConstraint(element.getConstraint());
    field->setAlign(element.takeAlign(NtAlign::Left));
    if (std::optional<std::string> const text = element.takeLabelString())
        field->setString(text->c_str(), End, false, false);
}

RttiType const& UiTextField::getClassType()
{
    return RttiGenType1<UiTextField, UiWidget>::getInstance();
}

RttiType const& UiTextField::getRttiType() const
{
    return getClassType();
}

char const* UiTextField::getString() const
{
    return _text ? _text->c_str() : nullptr;
}

void UiTextField::setString(char const* text, CursorPosition position, bool append, bool notify)
{
    requireUiThread();
    RCShdPtr<UiTextField> const self(this);
    if (text)
        LiStringUtil::requireUtf8(text, "Text of a text field");
    if (append && text)
        _text = _text.value_or("") + text;
    else if (!append)
        _text = text ? std::optional<std::string>(text) : std::nullopt;
    _textBeforeEdit = _text;
    if (_native)
        _native->setText(_text.value_or(""), position == End);
    if (notify)
        fire(PiWidget::ValueChanged);
}

void UiTextField::setAlign(NtAlign align)
{
    requireUiThread();
    _align = align;
    if (_native)
        _native->setAlign(align);
}

void UiTextField::onClicked()
{
    RCShdPtr<UiTextField> const self(this);
    if (takesInput())
        fire(PiWidget::Activate);
}

void UiTextField::onTextEdited(std::string const& text)
{
    _text = text;
}

void UiTextField::onEditEnded()
{
    RCShdPtr<UiTextField> const self(this);
    if (!takesInput() || _text.value_or("") == _textBeforeEdit.value_or(""))
        return;
    _textBeforeEdit = _text;
    fire(PiWidget::ValueChanged);
}

std::unique_ptr<NtPeer> UiTextField::createPeer(NtPlatform& platform, NtContainer& parent)
{
    std::unique_ptr<NtTextField> peer = platform.createTextField(parent, getName(), *this);
    peer->setText(_text.value_or(""), true);
    peer->setAlign(_align);
    _native = peer.get();
    return peer;
}

void UiTextField::dropPeer()
{
    _native = nullptr;
    UiWidget::dropPeer();
}

} // namespace Kv
