#include "xml/xmlWriter.h"

#include "text/liString.h"
#include "xml/xmlError.h"
#include "xml/xmlSyntax.h"

#include <ostream>

namespace Kv
{

namespace
{

constexpr char const* escapedInText = "<>&\"\r";
// A reader turns these, when they stand in an attribute as they are, into blanks.
constexpr char const* escapedInAttribute = "<>&\"\r\n\t";

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

std::string escape(std::string const& text, char const* escaped)
{
    std::string result;
    std::size_t copied = 0;
    for (std::size_t place = text.find_first_of(escaped); place != std::string::npos;
         place = text.find_first_of(escaped, copied))
    {
        result.append(text, copied, place - copied) += getReference(text[place]);
        copied = place + 1;
    }
    return result.append(text, copied);
}

std::size_t requireIndent(int indent)
{
    if (indent < 0)
        fail("An indentation of " + LiStringUtil::convertNb(indent) + " blanks");
    return static_cast<std::size_t>(indent);
}

} // namespace

XmlWriter::XmlWriter(std::ostream& stream, int indent) : _stream(stream), _indent(requireIndent(indent)) {}

XmlWriter::~XmlWriter() = default;

void XmlWriter::openTag(std::string const& name)
{
    requireElement(name);
    write(getLead() + "<" + name);
    _openNames.push_back(name);
    _attributeNames.clear();
    _isStartTagOpen = true;
    _hasRoot = true;
}

void XmlWriter::writeAttrib(std::string const& name, std::string const& value)
{
    requireAttribute(name);
    requireText(value, "attribute '" + name + "' of element '" + _openNames.back() + "'");
    write(" " + name + "=\"" + escape(value, escapedInAttribute) + "\"");
    _attributeNames.insert(name);
}

void XmlWriter::writeAttrib(std::string const& name, char const* value)
{
    writeAttrib(name, std::string(value ? value : ""));
}

void XmlWriter::writeAttrib(std::string const& name, int value)
{
    writeAttrib(name, LiStringUtil::convertNb(value));
}

void XmlWriter::writeTag(std::string const& name, std::string const& text)
{
    requireElement(name);
    requireText(text, "text of element '" + name + "'");
    std::string const tail = text.empty() ? "/>" : ">" + escape(text, escapedInText) + "</" + name + ">";
    write(getLead() + "<" + name + tail + getTrail(_openNames.size()));
    _isStartTagOpen = false;
    _hasRoot = true;
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
    write((_isStartTagOpen ? "/>" : getLineLead(depth) + "</" + _openNames.back() + ">") + getTrail(depth));
    _openNames.pop_back();
    _isStartTagOpen = false;
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
    if (_attributeNames.count(name) != 0)
        fail("Attribute '" + name + "' of element '" + _openNames.back() + "' is written twice");
}

/// The text in front of a new element: the end of the parent's start tag, and a new line.
std::string XmlWriter::getLead() const
{
    if (_openNames.empty())
        return {};
    return (_isStartTagOpen ? ">" : "") + getLineLead(_openNames.size());
}

std::string XmlWriter::getLineLead(std::size_t depth) const
{
    return "\n" + std::string(depth * _indent, ' ');
}

/// The text behind a whole element with `depth` elements open around it.
char const* XmlWriter::getTrail(std::size_t depth) const
{
    return depth == 0 ? "\n" : "";
}

void XmlWriter::write(std::string const& text)
{
    if (!_stream.write(text.data(), static_cast<std::streamsize>(text.size())))
        fail("The stream of an XML document takes no more text");
}

} // namespace Kv
