#include "uiTextField.h"

#include "text/liString.h"
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
    RCShdPtr<UiTextField> const field = UiTextField::create(parent, element.getName().c_str(), nullptr);
    field->setAlign(element.takeAlign(NtAlign::Left));
    if (std::optional<std::string> const text = element.takeLabelString())
        field->setString(text->c_str(), UiTextField::End, false, false);
}

UiWidgetKind const registered("TextField", &build);

} // namespace

UiTextField::UiTextField(std::string name) : UiPeeredWidget(std::move(name)) {}

RCShdPtr<UiTextField> UiTextField::create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*)
{
    RCShdPtr<UiTextField> field(new UiTextField(name));
    parent->addChild(field);
    return field;
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
    if (NtTextField* const peer = getPeer())
        peer->setText(_text.value_or(""), position == End);
    if (notify)
        fire(PiWidget::ValueChanged);
}

void UiTextField::setAlign(NtAlign align)
{
    requireUiThread();
    _align = align;
    if (NtTextField* const peer = getPeer())
        peer->setAlign(align);
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

void UiTextField::showState(NtTextField& peer)
{
    peer.setText(_text.value_or(""), true);
    peer.setAlign(_align);
}

} // namespace Kv
