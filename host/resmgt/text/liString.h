#pragma once

#include "kvExport.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace Kv
{

/// The host's string: bytes, as a rule UTF-8, of any content.
class KV_API LiString
{
public:
    LiString();
    LiString(LiString const&);
    LiString(LiString&&) noexcept;
    LiString& operator=(LiString const&);
    LiString& operator=(LiString&&) noexcept;
    ~LiString();

    /// A null text gives the empty string.
    LiString(char const* text);
    LiString(std::string text);

    /// The text ended by a zero byte; borrowed, valid while the string lives unchanged.
    char const* getChars() const;

    /// The whole text, with any zero bytes in it.
    std::string const& toString() const;

    bool isEmpty() const;

private:
    std::string _text;
};

KV_API bool operator==(LiString const& a, LiString const& b);
KV_API bool operator!=(LiString const& a, LiString const& b);

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
