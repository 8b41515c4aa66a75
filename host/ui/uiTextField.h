#pragma once

#include "ntTextField.h"
#include "uiPeeredWidget.h"

namespace Kv
{

/// An editable line of text. Raises `ValueChanged` when the user ends an edit with Enter that has changed the text, and
/// `Activate` when the user clicks it. Its text is what stands on the screen, Enter pressed or not.
class KV_API UiTextField : public UiPeeredWidget<NtTextField>
{
public:
    /// The place of the text cursor after a new text.
    enum CursorPosition
    {
        Start = 0,
        End = 1,
    };

    /// A text field at the end of `parent`. There are no resource tables for the built-in kinds: pass null.
    static RCShdPtr<UiTextField> create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*);

    /// UTF-8, valid until the text changes; null where a null text was the last that was set.
    char const* getString() const;

    /// Replaces the text. A null one leaves the field without a string: empty on the screen and null when read.
    /// With `append` the text goes behind the one that is there. With `notify` the handlers of `ValueChanged` run,
    /// also when the text stays the same. Throws an `ExBase` for a text that is no UTF-8.
    void setString(char const* text, CursorPosition position, bool append, bool notify);

    /// Places the text in the widget from left to right.
    void setAlign(NtAlign align);

protected:
    explicit UiTextField(std::string name);

private:
    void showState(NtTextField& peer) override;
    void onClicked() override;
    void onTextEdited(std::string const& text) override;
    void onEditEnded() override;

    std::optional<std::string> _text = "";
    /// The text that an edit under way began with.
    std::optional<std::string> _textBeforeEdit = "";
    NtAlign _align = NtAlign::Left;
};

} // namespace Kv
