#include "resmgt/xmlChecker.h"

#include "resmgt/liStringUtil.h"
#include "resmgt/xmlSyntax.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdint>
#include <cstring>
#include <optional>
#include <utf8.h>

namespace Kv
{

namespace
{

// The characters at which decoding must stop and look.
constexpr char const* specialInText = "&]\r";
constexpr char const* specialInCdata = "\r";
constexpr char const* specialInAttribute = "&<\t\r\n";

struct Entity
{
    std::string_view name;
    char character;
};

constexpr std::array<Entity, 5> entities = {{{"amp", '&'}, {"lt", '<'}, {"gt", '>'}, {"quot", '"'}, {"apos", '\''}}};

/// The character that a reference stands for, from what is between '&' and ';'; nothing where it is none.
std::optional<std::uint32_t> findReferenced(std::string_view reference)
{
    for (Entity const& entity : entities)
        if (entity.name == reference)
            return entity.character;
    if (reference.empty() || reference.front() != '#')
        return std::nullopt;
    bool const isHexadecimal = reference.substr(0, 2) == "#x";
    char const* const end = reference.data() + reference.size();
    std::uint32_t codePoint = 0;
    auto const result =
        std::from_chars(reference.data() + (isHexadecimal ? 2 : 1), end, codePoint, isHexadecimal ? 16 : 10);
    if (result.ec != std::errc() || result.ptr != end || !XmlSyntax::isCharacter(codePoint))
        return std::nullopt;
    return codePoint;
}

} // namespace

XmlChecker::XmlChecker(std::string& text, XmlLines const& lines) : _text(text), _lines(lines) {}

bool XmlChecker::for_each(pugi::xml_node& node)
{
    if (depth() == 0)
        checkTopLevel(node);
    switch (node.type())
    {
    case pugi::node_element:
        checkElement(node);
        break;
    case pugi::node_pcdata:
        decode(node.value(), specialInText, '\n');
        break;
    case pugi::node_cdata:
        decode(node.value(), specialInCdata, '\n');
        break;
    case pugi::node_comment:
        checkComment(node.value());
        break;
    case pugi::node_pi:
        requireName(node.name());
        break;
    case pugi::node_declaration:
        fail(node.name(), "an XML declaration that is not the first thing in the text");
    case pugi::node_doctype:
        fail(node.value(), "a document type definition (DOCTYPE) is not supported");
    default:
        break;
    }
    return true;
}

void XmlChecker::checkTopLevel(pugi::xml_node node)
{
    char const* const text = node.value();
    if (node.type() == pugi::node_cdata)
        fail(text, "text outside of the root element: " + LiStringUtil::getPrintable(text));
    if (node.type() == pugi::node_pcdata)
    {
        char const* const place = text + std::strspn(text, XmlSyntax::blanks);
        if (*place != '\0')
            fail(place, "text outside of the root element: " + LiStringUtil::getPrintable(place));
    }
    if (node.type() == pugi::node_element)
    {
        if (_hasRoot)
            fail(node.name(), "a second root element: " + LiStringUtil::getPrintable(node.name()));
        _hasRoot = true;
    }
}

void XmlChecker::checkElement(pugi::xml_node node)
{
    if (depth() >= XmlSyntax::maximumDepth)
        fail(node.name(), "elements nested deeper than " + std::to_string(XmlSyntax::maximumDepth));
    requireName(node.name());
    checkAttributes(node);
}

void XmlChecker::checkAttributes(pugi::xml_node node)
{
    _attributeNames.clear();
    for (pugi::xml_attribute const attribute : node.attributes())
    {
        requireName(attribute.name());
        decode(attribute.value(), specialInAttribute, ' ');
        _attributeNames.emplace_back(attribute.name());
    }
    std::sort(_attributeNames.begin(), _attributeNames.end());
    auto const twice = std::adjacent_find(_attributeNames.begin(), _attributeNames.end());
    if (twice != _attributeNames.end())
        fail(std::max(twice[0].data(), twice[1].data()),
             "attribute " + LiStringUtil::getPrintable(*twice) + " stands twice in element '" + node.name() + "'");
}

void XmlChecker::checkComment(char const* value) const
{
    char const* const dashes = std::strstr(value, "--");
    if (dashes)
        fail(dashes, "'--' inside a comment");
    std::size_t const length = std::strlen(value);
    if (length > 0 && value[length - 1] == '-')
        fail(value + length, "a comment that ends with '--->'");
}

void XmlChecker::requireName(char const* name) const
{
    if (!XmlSyntax::isName(name))
        fail(name, "no XML name: " + LiStringUtil::getPrintable(name));
}

/// Puts what is meant in the place of what is written; it is never longer. Only `special` characters need a look.
void XmlChecker::decode(char const* value, char const* special, char lineEnd) const
{
    if (*value == '\0')
        return;
    char* out = _text.data() + (value - _text.data());
    for (char const* in = value;;)
    {
        std::size_t const plain = std::strcspn(in, special);
        std::memmove(out, in, plain);
        in += plain;
        out += plain;
        switch (*in)
        {
        case '\0':
            *out = '\0';
            return;
        case '&':
            decodeReference(in, out);
            break;
        case '<':
            fail(in, "'<' inside an attribute's value; it is written &lt;");
        case ']':
            if (std::strncmp(in, "]]>", 3) == 0)
                fail(in, "']]>' inside a text; its '>' is written &gt;");
            *out++ = *in++;
            break;
        default:
            in += std::strncmp(in, "\r\n", 2) == 0 ? 2 : 1;
            *out++ = lineEnd;
        }
    }
}

void XmlChecker::decodeReference(char const*& in, char*& out) const
{
    char const* const begin = in + 1;
    char const* const end = begin + std::strcspn(begin, ";& \t\r\n");
    if (*end != ';' || end == begin)
        fail(in, "'&' without a reference behind it; by itself it is written &amp;");
    auto const character = findReferenced({begin, static_cast<std::size_t>(end - begin)});
    if (!character)
        fail(in, "no reference to a character of XML: " +
                     LiStringUtil::getPrintable({in, static_cast<std::size_t>(end + 1 - in)}));
    out = utf8::append(*character, out);
    in = end + 1;
}

void XmlChecker::fail(char const* place, std::string const& words) const
{
    _lines.fail(static_cast<std::size_t>(place - _text.data()), words);
}

} // namespace Kv
