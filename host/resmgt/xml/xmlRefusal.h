#pragma once

#include <cstddef>
#include <expat.h>
#include <string>
#include <string_view>

namespace Kv
{

/// What the parser does not take of a text.
struct XmlRefusal
{
    XML_Error error;
    /// The line of `place`.
    int line;
    std::string_view text;
    /// Where the tag or whatever it is begins, and where it goes wrong.
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
