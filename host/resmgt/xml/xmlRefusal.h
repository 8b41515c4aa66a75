#pragma once

#include <cstddef>
#include <expat.h>
#include <string>
#include <string_view>

namespace Kv
{

/// A place in a text that the parser refuses, and why.
struct XmlRefusal
{
    XML_Error error;
    /// The line of `place`.
    int line;
    std::string_view text;
    /// The start of the tag, or whatever it is, and the place of the fault in it.
    std::size_t begin;
    std::size_t place;
    /// The innermost element that is open, with its line; empty where none is.
    std::string openElement;
    /// As the text declares it; empty where it does not.
    std::string encoding;

    /// Throws an `XmlError` with words for the author of the text.
    [[noreturn]] void raise() const;
};

} // namespace Kv
