#pragma once

#include "resmgt/xmlLines.h"

#include <pugixml.hpp>
#include <string>
#include <string_view>

namespace Kv
{

/// The nodes of a document that has been read and found good, and the text that they point into.
class XmlTree
{
public:
    /// Throws `XmlError` with the line for what `XmlDocument` refuses.
    explicit XmlTree(std::string const& text);
    XmlTree(XmlTree const&) = delete;
    XmlTree& operator=(XmlTree const&) = delete;
    ~XmlTree();

    /// The root element, or a null node. All values in the tree are decoded.
    pugi::xml_node getRoot() const;

    /// The line, from 1, of a place in the text, such as a node's name.
    int getLine(char const* place) const;

private:
    explicit XmlTree(std::string_view text);

    void parse(std::string_view original, std::size_t begin);

    // The parser works in place: names and values are stretches of this text, ended by zero bytes of their own.
    std::string _text;
    XmlLines _lines;
    pugi::xml_document _document;
};

} // namespace Kv
