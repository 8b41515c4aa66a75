#include "xml/xmlWriter.h"

#include "text/liString.h"
#include "xml/xmlError.h"
#include "xml/xmlSyntax.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <ostream>
#include <string_view>

namespace Kv
{

namespace
{

[[noreturn]] void fail(std::string const& words)
{
    throw XmlError(__FILE__, __LINE__, 0, words);
}

char const* getReference(char character)
{
    switch (character)
    {
    case '<':
        return "&lt;";
    case '>':
        return "&gt;";
    case '&':
        return "&amp;";
    case '"':
        return "&quot;";
    case '\t':
        return "&#9;";
    case '\n':
        return "&#10;";
    default:
        return "&#13;";
    }
}

/// True for the bytes that stand as references.
using Escaped = std::array<bool, 256>;

constexpr Escaped makeEscaped(std::string_view characters)
{
    Escaped escaped{};
    for (char const character : characters)
        escaped[static_cast<unsigned char>(character)] = true;
    return escaped;
}

constexpr Escaped escapedInText = makeEscaped("<>&\"\r");
// A reader turns these, when they stand in an attribute as they are, into blanks.
constexpr Escaped escapedInAttribute = makeEscaped("<>&\"\r\n\t");

std::size_t requireIndent(int indent)
{
    if (indent < 0)
        fail("An indentation of " + LiStringUtil::convertNb(indent) + " blanks");
    return static_cast<std::size_t>(indent);
}

} // namespace

XmlWriter::XmlWriter(std::ostream& stream, int indent) : _stream(stream), _indent(requireIndent(indent)) {}

XmlWriter::~XmlWriter() = default;

// These come first: they are inlined in what follows.

char* XmlWriter::makeRoom(std::size_t size)
{
    if (_text.size() - _textSize < size)
        grow(size);
    return _text.data() + _textSize;
}

void XmlWriter::add(char character)
{
    *makeRoom(1) = character;
    ++_textSize;
}

void XmlWriter::add(std::string_view text)
{
    std::copy(text.begin(), text.end(), makeRoom(text.size()));
    _textSize += text.size();
}

void XmlWriter::openTag(std::string const& name)
{
    requireElement(name);
    beginTag(name);
    _openNames.push_back(name);
    _attributeCount = 0;
    _isStartTagOpen = true;
    _hasRoot = true;
    flush();
}

void XmlWriter::writeAttrib(std::string const& name, std::string const& value)
{
    requireAttribute(name);
    if (XmlSyntax::findOffence(value))
        requireText(value, "attribute '" + name + "' of element '" + _openNames.back() + "'");
    beginAttribute(name);
    addEscaped(value, escapedInAttribute);
    add('"');
    rememberAttribute(name);
}

void XmlWriter::writeAttrib(std::string const& name, char const* value)
{
    writeAttrib(name, std::string(value ? value : ""));
}

void XmlWriter::writeAttrib(std::string const& name, int value)
{
    requireAttribute(name);
    beginAttribute(name);
    std::array<char, 16> digits;
    char const* const end = std::to_chars(digits.data(), digits.data() + digits.size(), value).ptr;
    add(std::string_view(digits.data(), static_cast<std::size_t>(end - digits.data())));
    add('"');
    rememberAttribute(name);
}

void XmlWriter::writeTag(std::string const& name, std::string const& text)
{
    requireElement(name);
    if (XmlSyntax::findOffence(text))
        requireText(text, "text of element '" + name + "'");
    beginTag(name);
    if (text.empty())
        add("/>");
    else
    {
        add('>');
        addEscaped(text, escapedInText);
        endTag(name);
    }
    _isStartTagOpen = false;
    _hasRoot = true;
    flush();
}

void XmlWriter::writeTag(std::string const& name, char const* text)
{
    writeTag(name, std::string(text ? text : ""));
}

void XmlWriter::writeTag(std::string const& name, int number)
{
    writeTag(name, LiStringUtil::convertNb(number));
}

void XmlWriter::closeTag()
{
    if (_openNames.empty())
        fail("There is no open element to close");
    std::size_t const depth = _openNames.size() - 1;
    if (_isStartTagOpen)
        add("/>");
    else
    {
        addLine(depth);
        endTag(_openNames.back());
    }
    _openNames.pop_back();
    _isStartTagOpen = false;
    flush();
}

void XmlWriter::requireText(std::string const& text, std::string const& what)
{
    if (auto const offence = XmlSyntax::findOffence(text))
        fail(what + ": " + offence->words + ": " + LiStringUtil::getPrintable(text, offence->offset));
}

void XmlWriter::requireElement(std::string const& name) const
{
    if (!XmlSyntax::isName(name))
        fail("No name for an XML element: " + LiStringUtil::getPrintable(name));
    if (_openNames.empty() && _hasRoot)
        fail("Element '" + name + "' would be a second root element");
    if (_openNames.size() >= XmlSyntax::maximumDepth)
        fail("Element '" + name + "' would be nested deeper than " + std::to_string(XmlSyntax::maximumDepth));
}

void XmlWriter::requireAttribute(std::string const& name) const
{
    if (!XmlSyntax::isName(name))
        fail("No name for an XML attribute: " + LiStringUtil::getPrintable(name));
    if (!_isStartTagOpen)
        fail("Attribute '" + name + "' does not follow the opening of an element");
    auto const end = _attributeNames.begin() + static_cast<std::ptrdiff_t>(_attributeCount);
    if (std::find(_attributeNames.begin(), end, name) != end)
        fail("Attribute '" + name + "' of element '" + _openNames.back() + "' is written twice");
}

/// Ends the parent's start tag, begins a line and opens the tag.
void XmlWriter::beginTag(std::string const& name)
{
    if (_isStartTagOpen)
        add('>');
    if (!_openNames.empty())
        addLine(_openNames.size());
    add('<');
    add(name);
}

void XmlWriter::endTag(std::string const& name)
{
    add("</");
    add(name);
    add('>');
}

void XmlWriter::beginAttribute(std::string const& name)
{
    add(' ');
    add(name);
    add("=\"");
}

void XmlWriter::addLine(std::size_t depth)
{
    add('\n');
    std::size_t const width = depth * _indent;
    std::fill_n(makeRoom(width), width, ' ');
    _textSize += width;
}

void XmlWriter::addEscaped(std::string const& text, std::array<bool, 256> const& escaped)
{
    std::string_view const all = text;
    std::size_t added = 0;
    for (std::size_t place = 0; place < all.size(); ++place)
        if (escaped[static_cast<unsigned char>(all[place])])
        {
            add(all.substr(added, place - added));
            add(getReference(all[place]));
            added = place + 1;
        }
    add(all.substr(added));
}

void XmlWriter::grow(std::size_t size)
{
    constexpr std::size_t least = 4096;
    _text.resize(std::max({least, 2 * _text.size(), _textSize + size}));
}

void XmlWriter::flush()
{
    constexpr std::size_t much = 1 << 16;
    bool const isWhole = _openNames.empty();
    if (isWhole)
        add('\n');
    if (isWhole || _textSize > much)
    {
        _stream.write(_text.data(), static_cast<std::streamsize>(_textSize));
        _textSize = 0;
    }
    if (!_stream)
        fail("The stream of an XML document takes no more text");
}

void XmlWriter::rememberAttribute(std::string const& name)
{
    if (_attributeCount == _attributeNames.size())
        _attributeNames.push_back(name);
    else
        _attributeNames[_attributeCount] = name;
    ++_attributeCount;
}

} // namespace Kv
