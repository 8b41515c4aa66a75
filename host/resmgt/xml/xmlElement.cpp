#include "xml/xmlElement.h"

#include "text/liString.h"
#include "xml/xmlError.h"
#include "xml/xmlSyntax.h"
#include "xml/xmlTree.h"

#include <utility>

namespace Kv
{

XmlElement::XmlElement(std::shared_ptr<XmlTree const> tree, std::uint32_t index) : _tree(std::move(tree)), _index(index)
{
}

std::string XmlElement::getName() const
{
    return std::string(_tree->get(_tree->elements[_index].name));
}

int XmlElement::getLine() const
{
    return _tree->elements[_index].line;
}

std::optional<std::string> XmlElement::findAttribute(std::string const& name) const
{
    XmlTree::Element const& element = _tree->elements[_index];
    for (std::uint32_t i = element.firstAttribute; i < element.attributesEnd; ++i)
        if (_tree->get(_tree->attributes[i].name) == name)
            return std::string(_tree->get(_tree->attributes[i].value));
    return std::nullopt;
}

std::string XmlElement::getAttribute(std::string const& name) const
{
    std::optional<std::string> value = findAttribute(name);
    if (!value)
        throw XmlError(__FILE__, __LINE__, getLine(),
                       "element '" + getName() + "' has no attribute " + LiStringUtil::getPrintable(name));
    return std::move(*value);
}

std::vector<std::string> XmlElement::getAttributeNames() const
{
    std::vector<std::string> names;
    XmlTree::Element const& element = _tree->elements[_index];
    for (std::uint32_t i = element.firstAttribute; i < element.attributesEnd; ++i)
        names.emplace_back(_tree->get(_tree->attributes[i].name));
    return names;
}

std::vector<XmlElement> XmlElement::getChildren() const
{
    std::vector<XmlElement> children;
    std::vector<XmlTree::Element> const& elements = _tree->elements;
    for (std::uint32_t i = _index + 1; i < elements[_index].end; i = elements[i].end)
        children.emplace_back(_tree, i);
    return children;
}

std::optional<XmlElement> XmlElement::findChild(std::string const& name) const
{
    std::vector<XmlTree::Element> const& elements = _tree->elements;
    for (std::uint32_t i = _index + 1; i < elements[_index].end; i = elements[i].end)
        if (_tree->get(elements[i].name) == name)
            return XmlElement(_tree, i);
    return std::nullopt;
}

std::string XmlElement::getText() const
{
    return std::string(_tree->get(_tree->elements[_index].text));
}

bool XmlElement::hasText() const
{
    return _tree->get(_tree->elements[_index].text).find_first_not_of(XmlSyntax::blanks) != std::string_view::npos;
}

} // namespace Kv
