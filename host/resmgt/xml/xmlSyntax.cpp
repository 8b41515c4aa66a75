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

/// The parts that a byte can have in a text or a name.
enum Part : unsigned char
{
    Plain = 1,
    StartsName = 2,
    ContinuesName = 4,
};

constexpr std::array<unsigned char, 256> classifyBytes()
{
    std::array<unsigned char, 256> parts{};
    for (std::size_t i = 0; i < parts.size(); ++i)
    {
        bool const isLetter = (i >= 'a' && i <= 'z') || (i >= 'A' && i <= 'Z');
        bool const isDigit = i >= '0' && i <= '9';
        if (i < 0x80 && (i >= ' ' || i == '\t' || i == '\n' || i == '\r'))
            parts[i] |= Plain;
        if (isLetter || i == '_' || i == ':' || i >= 0x80)
            parts[i] |= StartsName | ContinuesName;
        else if (isDigit || i == '-' || i == '.')
            parts[i] |= ContinuesName;
    }
    return parts;
}

constexpr std::array<unsigned char, 256> partsOfBytes = classifyBytes();

bool has(char character, Part part)
{
    return (partsOfBytes[static_cast<unsigned char>(character)] & part) != 0;
}

} // namespace

bool isName(std::string const& text)
{
    if (text.empty() || !has(text.front(), StartsName))
        return false;
    unsigned seen = 0;
    for (char const character : text)
    {
        if (!has(character, ContinuesName))
            return false;
        seen |= static_cast<unsigned char>(character);
    }
    if (seen < 0x80)
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
    if (std::all_of(text.begin(), text.end(), [](char character) { return has(character, Plain); }))
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
