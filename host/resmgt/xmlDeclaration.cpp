#include "resmgt/xmlDeclaration.h"

#include "resmgt/liStringUtil.h"
#include "resmgt/xmlSyntax.h"

#include <algorithm>
#include <pugixml.hpp>
#include <string>

namespace Kv::XmlDeclaration
{

namespace
{

constexpr std::string_view opening = "<?xml";
constexpr std::string_view closing = "?>";

bool isNamed(pugi::xml_attribute attribute, std::string_view name)
{
    return attribute.name() == name;
}

bool isDigit(char character)
{
    return character >= '0' && character <= '9';
}

bool isVersion(std::string_view value)
{
    return value.size() > 2 && value.substr(0, 2) == "1." && std::all_of(value.begin() + 2, value.end(), isDigit);
}

bool isEncoding(std::string value)
{
    auto const toLower = [](char character)
    { return character >= 'A' && character <= 'Z' ? static_cast<char>(character - 'A' + 'a') : character; };
    std::transform(value.begin(), value.end(), value.begin(), toLower);
    return value == "utf-8" || value == "us-ascii";
}

bool isStandalone(std::string_view value)
{
    return value == "yes" || value == "no";
}

bool isPresent(std::string_view text)
{
    if (text.substr(0, opening.size()) != opening || text.size() == opening.size())
        return false;
    // Any other character makes it the longer name of an instruction.
    char const next = text[opening.size()];
    return next == '?' || std::string_view(XmlSyntax::blanks).find(next) != std::string_view::npos;
}

} // namespace

std::size_t check(std::string_view text, XmlLines const& lines)
{
    if (!isPresent(text))
        return 0;
    std::size_t const end = text.find(closing);
    if (end == std::string_view::npos)
        lines.fail(0, "the XML declaration is not closed");

    // Its content has the form of attributes, so it is read as an element's.
    std::string const content(text.substr(opening.size(), end - opening.size()));
    pugi::xml_document document;
    bool const isReadable =
        content.find_first_of("<>&") == std::string::npos && document.load_string(("<xml" + content + "/>").c_str());
    pugi::xml_attribute attribute = document.first_child().first_attribute();
    if (!isReadable || !isNamed(attribute, "version") || !isVersion(attribute.value()))
        lines.fail(0, "no XML declaration of version 1: " + LiStringUtil::getPrintable(text));
    attribute = attribute.next_attribute();
    if (isNamed(attribute, "encoding"))
    {
        if (!isEncoding(attribute.value()))
            lines.fail(0, "the encoding is not UTF-8 but " + LiStringUtil::getPrintable(attribute.value()));
        attribute = attribute.next_attribute();
    }
    if (isNamed(attribute, "standalone") && isStandalone(attribute.value()))
        attribute = attribute.next_attribute();
    if (attribute)
        lines.fail(0, "the XML declaration cannot have " + LiStringUtil::getPrintable(attribute.name()) + " as " +
                          LiStringUtil::getPrintable(attribute.value()) + " there");
    return end + closing.size();
}

} // namespace Kv::XmlDeclaration
