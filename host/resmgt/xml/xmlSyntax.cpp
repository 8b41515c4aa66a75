#include "xml/xmlSyntax.h"

#include <algorithm>
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

bool isAscii(char character)
{
    return static_cast<unsigned char>(character) < 0x80;
}

bool startsName(char character)
{
    return (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z') || character == '_' ||
           character == ':' || !isAscii(character);
}

bool continuesName(char character)
{
    return startsName(character) || (character >= '0' && character <= '9') || character == '-' || character == '.';
}

} // namespace

bool isName(std::string const& text)
{
    if (text.empty() || !startsName(text.front()) || !std::all_of(text.begin(), text.end(), continuesName))
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
