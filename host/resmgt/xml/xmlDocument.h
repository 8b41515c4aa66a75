#pragma once

#include "kvExport.h"
#include "pointers/rcShdPtr.h"
#include "xml/xmlElement.h"

#include <cstddef>
#include <string>

namespace Kv
{

/// An XML document, read from its text.
class KV_API XmlDocument
{
public:
    /// Reads `text`, which is the document itself and no file name, in UTF-8 or in the other encodings that the parser
    /// knows. Throws `XmlError` with the line for whatever is not well-formed, for a document type definition, and for
    /// elements nested deeper than 1024.
    explicit XmlDocument(std::string const& text);
    XmlDocument(XmlDocument const&) = delete;
    XmlDocument& operator=(XmlDocument const&) = delete;
    ~XmlDocument();

    /// The root element, which lives on without the document. Null for a text without any element in it: empty, or
    /// nothing but white space and comments.
    RCShdPtr<XmlElement> getRoot() const;

private:
    RCShdPtr<XmlElement> _root;
    /// That of the text, in bytes.
    std::size_t _size;
};

} // namespace Kv
