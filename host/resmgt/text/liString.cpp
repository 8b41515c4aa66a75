#include "text/liString.h"

#include "exBase.h"

#include <algorithm>
#include <utf8.h>
#include <utility>

namespace Kv
{

namespace
{

constexpr std::ptrdiff_t shownBefore = 24;
constexpr int shownCharacters = 64;

std::string escapedByte(char byte)
{
    constexpr char const* digits = "0123456789abcdef";
    auto const value = static_cast<unsigned char>(byte);
    return {'\\', 'x', digits[value >> 4U], digits[value & 0xfU]};
}

bool isPrintable(char32_t character)
{
    bool const isControl = character < 0x20 || (character >= 0x7f && character <= 0x9f);
    bool const isLineEnd = character == 0x2028 || character == 0x2029;
    return !isControl && !isLineEnd && (character & 0xfffeU) != 0xfffe;
}

/// The printable form of one well-formed character, or of one byte that is none.
std::string printableCharacter(std::string_view bytes)
{
    if (bytes == "\n")
        return "\\n";
    if (bytes == "\r")
        return "\\r";
    if (bytes == "\t")
        return "\\t";
    if (bytes == "'" || bytes == "\\")
        return "\\" + std::string(bytes);
    if (utf8::is_valid(bytes.begin(), bytes.end()) && isPrintable(utf8::peek_next(bytes.begin(), bytes.end())))
        return std::string(bytes);
    std::string escapes;
    for (char const byte : bytes)
        escapes += escapedByte(byte);
    return escapes;
}

/// The first character of a text that is not empty, or its first byte where no well-formed character begins.
std::string_view firstCharacter(std::string_view text)
{
    for (std::size_t length = 1; length <= std::min<std::size_t>(4, text.size()); ++length)
        if (utf8::is_valid(text.begin(), text.begin() + length))
            return text.substr(0, length);
    return text.substr(0, 1);
}

/// The first characters of a text, which it loses.
std::string takePrintable(std::string_view& text, int count)
{
    std::string printable;
    for (int taken = 0; taken < count && !text.empty(); ++taken)
    {
        std::string_view const character = firstCharacter(text);
        printable += printableCharacter(character);
        text.remove_prefix(character.size());
    }
    return printable;
}

} // namespace

LiString::LiString() = default;

LiString::LiString(LiString const&) = default;

LiString::LiString(LiString&&) noexcept = default;

LiString& LiString::operator=(LiString const&) = default;

LiString& LiString::operator=(LiString&&) noexcept = default;

LiString::~LiString() = default;

LiString::LiString(char const* text) : _text(text ? text : "") {}

LiString::LiString(std::string text) : _text(std::move(text)) {}

char const* LiString::getChars() const
{
    return _text.c_str();
}

std::string const& LiString::toString() const
{
    return _text;
}

bool LiString::isEmpty() const
{
    return _text.empty();
}

bool operator==(LiString const& a, LiString const& b)
{
    return a.toString() == b.toString();
}

bool operator!=(LiString const& a, LiString const& b)
{
    return !(a == b);
}

std::string LiStringUtil::convertNb(int number)
{
    return std::to_string(number);
}

bool LiStringUtil::isUtf8(std::string const& text)
{
    return utf8::is_valid(text.begin(), text.end());
}

void LiStringUtil::requireUtf8(std::string const& text, char const* what)
{
    auto const invalid = utf8::find_invalid(text.begin(), text.end());
    if (invalid != text.end())
        throw ExBase(__FILE__, __LINE__,
                     std::string(what) + ": not valid UTF-8: " + getPrintable(text, invalid - text.begin()));
    std::size_t const zero = text.find('\0');
    if (zero != std::string::npos)
        throw ExBase(__FILE__, __LINE__, std::string(what) + ": holds a zero byte: " + getPrintable(text, zero));
}

std::string LiStringUtil::getPrintable(std::string_view text, std::size_t offset)
{
    auto const isContinuation = [](char byte) { return (static_cast<unsigned char>(byte) & 0xc0U) == 0x80; };
    char const* const place = text.data() + std::min(offset, text.size());
    char const* const begin =
        std::find_if_not(place - std::min(place - text.data(), shownBefore), place, isContinuation);

    std::string_view rest = text.substr(begin - text.data());
    std::string const printable = takePrintable(rest, shownCharacters);
    return (begin == text.data() ? "'" : "'...") + printable + (rest.empty() ? "'" : "...'");
}

std::string LiStringUtil::getPrintablePath(std::string_view path)
{
    // No system takes a longer one.
    constexpr int longest = 4096;
    std::string const printable = takePrintable(path, longest);
    return "'" + printable + (path.empty() ? "'" : "...'");
}

} // namespace Kv
