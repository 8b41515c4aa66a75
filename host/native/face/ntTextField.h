#pragma once

#include "ntPeer.h"

namespace Kv
{

/// Hears of the user of a text field.
class NtTextFieldListener
{
public:
    virtual ~NtTextFieldListener() = default;
    virtual void onClicked() = 0;
    virtual void onTextEdited(std::string const& text) = 0;
    /// Enter was pressed.
    virtual void onEditEnded() = 0;
};

/// One line of text that the user can edit. Enter ends the edit; losing the keyboard does not.
class NtTextField : public virtual NtPeer
{
public:
    using Listener = NtTextFieldListener;

    /// Replaces the text; the text cursor goes to the end, or to the start.
    virtual void setText(std::string const& text, bool cursorAtEnd) = 0;
    virtual void setAlign(NtAlign align) = 0;
};

} // namespace Kv
