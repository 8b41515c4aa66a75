#pragma once

#include "kvExport.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace Kv
{

/// Questions about texts, and the forms that they take in words for a person.
class KV_API LiStringUtil
{
public:
    /// The number in decimal, with a leading minus sign where it is negative, whatever the locale.
    static std::string convertNb(int number);

    /// True for well-formed UTF-8; zero bytes are allowed.
    static bool isUtf8(std::string const& text);

    /// Throws `ExBase` for a text that is not UTF-8 or that holds a zero byte. The words begin with `what`, which
    /// names the text, and show where it goes wrong.
    static void requireUtf8(std::string const& text, char const* what);

    /// The text in quotes on one line of valid UTF-8, whatever its bytes are: what cannot be printed stands as an
    /// escape. Of a long text only the surroundings of the byte at `offset` are shown.
    static std::string getPrintable(std::string_view text, std::size_t offset = 0);

    /// The same for a path, of which every part counts: all of it is shown.
    static std::string getPrintablePath(std::string_view path);
};

} // namespace Kv
