#pragma once

#include "kvExport.h"

#include <array>
#include <cstddef>
#include <iosfwd>
#include <string>
#include <string_view>
#include <vector>

namespace Kv
{

/// Writes one XML document, in UTF-8, onto a stream, piece by piece; behind the last `closeTag` the stream holds all of
/// it. What XML cannot hold, and calls that would give no document, throw `XmlError` and leave stream and writer as
/// they were. A stream that fails throws `XmlError` too, and is of no more use.
class KV_API XmlWriter
{
public:
    /// The stream is borrowed for the writer's lifetime. `indent` is the number of blanks per level, 0 or more.
    XmlWriter(std::ostream& stream, int indent);
    XmlWriter(XmlWriter const&) = delete;
    XmlWriter& operator=(XmlWriter const&) = delete;
    ~XmlWriter();

    /// Begins an element inside the innermost open one; the first is the root.
    void openTag(std::string const& name);

    /// Adds an attribute to the element just opened, before anything stands in it, each name once.
    void writeAttrib(std::string const& name, std::string const& value);
    void writeAttrib(std::string const& name, char const* value);
    void writeAttrib(std::string const& name, int value);

    /// Writes a whole element with nothing but a text in it. A null text is the empty one.
    void writeTag(std::string const& name, std::string const& text);
    void writeTag(std::string const& name, char const* text);
    void writeTag(std::string const& name, int number);

    /// Ends the innermost open element.
    void closeTag();

    /// Throws for what cannot be written as a text or as the value of an attribute; the words begin with `what`.
    static void requireText(std::string const& text, std::string const& what);

private:
    void requireElement(std::string const& name) const;
    void requireAttribute(std::string const& name) const;

    void beginTag(std::string const& name);
    void endTag(std::string const& name);
    void beginAttribute(std::string const& name);
    void addLine(std::size_t depth);
    void addEscaped(std::string const& text, std::array<bool, 256> const& escaped);
    void add(char character);
    void add(std::string_view text);

    /// Gives room for so many more bytes of text.
    char* makeRoom(std::size_t size);
    void grow(std::size_t size);

    /// Hands the text that waits to the stream, where that is all of the document or much.
    void flush();
    void rememberAttribute(std::string const& name);

    std::ostream& _stream;
    std::size_t _indent;
    std::vector<std::string> _openNames;
    /// Those of the element just opened are the first ones; the others wait to be used again.
    std::vector<std::string> _attributeNames;
    std::size_t _attributeCount = 0;
    /// Holds the text that the stream has not got yet, which is so many bytes.
    std::string _text;
    std::size_t _textSize = 0;
    bool _isStartTagOpen = false;
    bool _hasRoot = false;
};

} // namespace Kv
