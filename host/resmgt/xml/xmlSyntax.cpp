#include "xml/xmlSyntax.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <expat.h>
#include <memory>
#include <utf8.h>

namespace Kv::XmlSyntax
{

namespace
{

/// True for the code points of UTF-8 that may stand in a document.
bool isAllowed(std::uint32_t codePoint)
{
    if (codePoint < 0x20)
        return codePoint == '\t' || codePoint == '\n' || codePoint == '\r';
    return codePoint != 0xfffe && codePoint != 0xffff;
}

/// The part that a byte can have in a text or a name.
struct Byte
{
    bool isPlain = false;
    bool startsName = false;
    bool continuesName = false;
};

constexpr std::array<Byte, 256> classifyBytes()
{
    std::array<Byte, 256> bytes{};
    for (std::size_t i = 0; i < bytes.size(); ++i)
    {
        bool const isLetter = (i >= 'a' && i <= 'z') || (i >= 'A' && i <= 'Z');
        bool const isDigit = i >= '0' && i <= '9';
        bytes[i].isPlain = i < 0x80 && (i >= ' ' || i == '\t' || i == '\n' || i == '\r');
        bytes[i].startsName = isLetter || i == '_' || i == ':' || i >= 0x80;
        bytes[i].continuesName = bytes[i].startsName || isDigit || i == '-' || i == '.';
    }
    return bytes;
}

constexpr std::array<Byte, 256> bytes = classifyBytes();

Byte const& classify(char character)
{
    return bytes[static_cast<unsigned char>(character)];
}

bool isAscii(char character)
{
    return static_cast<unsigned char>(character) < 0x80;
}

} // namespace

bool isName(std::string const& text)
{
    auto const continuesName = [](char character) { return classify(character).continuesName; };
    if (text.empty() || !classify(text.front()).startsName || !std::all_of(text.begin(), text.end(), continuesName))
        return false;
    if (std::all_of(text.begin(), text.end(), isAscii))
        return true;
    // The parser knows which other characters are those of a name.
    std::string const element = "<" + text + "/>";
    std::unique_ptr<XML_ParserStruct, decltype(&XML_ParserFree)> const parser(XML_ParserCreate("UTF-8"),
                                                                              &XML_ParserFree);
    return XML_Parse(parser.get(), element.data(), static_cast<int>(element.size()), XML_TRUE) == XML_STATUS_OK;
}

std::optional<Offence> findOffence(std::string_view text)
{
    // Most texts are plain to the end.
    if (std::all_of(text.begin(), text.end(), [](char character) { return classify(character).isPlain; }))
        return std::nullopt;
    auto const* const begin = text.data();
    auto const* const end = begin + text.size();
    auto const* const validEnd = utf8::find_invalid(begin, end);
    for (auto const* place = begin; place != validEnd;)
    {
        auto const* const character = place;
        if (!isAllowed(utf8::unchecked::next(place)))
            return Offence{static_cast<std::size_t>(character - begin), "a character that XML cannot hold"};
    }
    if (validEnd != end)
        return Offence{static_cast<std::size_t>(validEnd - begin), "not valid UTF-8"};
    return std::nullopt;
}

} // namespace Kv::XmlSyntax
