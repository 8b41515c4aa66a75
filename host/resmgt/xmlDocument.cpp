#include "resmgt/xmlDocument.h"

#include "resmgt/xmlTree.h"

namespace Kv
{

XmlDocument::XmlDocument(std::string const& text)
{
    auto const tree = std::make_shared<XmlTree const>(text);
    if (pugi::xml_node const root = tree->getRoot())
        _root = makeShd<XmlElement>(tree, root.internal_object());
}

XmlDocument::~XmlDocument() = default;

RCShdPtr<XmlElement> XmlDocument::getRoot() const
{
    return _root;
}

} // namespace Kv
