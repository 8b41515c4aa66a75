#pragma once

#include "kvExport.h"

#include <functional>
#include <string>

namespace Kv
{

/// The text on the face of a widget, which owns it and follows its changes.
class KV_API UiString
{
public:
    /// `onChange` runs after each change.
    explicit UiString(std::function<void()> onChange);

    std::string const& getString() const { return _text; }

    /// Throws an `ExBase` for a text that is no UTF-8; the old one stays then.
    void setString(char const* text);

private:
    std::string _text;
    std::function<void()> _onChange;
};

} // namespace Kv
