#include "xml/xmlElement.h"

#include "text/liString.h"
#include "xml/xmlError.h"
#include "xml/xmlSyntax.h"
#include "xml/xmlTree.h"

#include <algorithm>
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

bool XmlElement::isNamed(std::string_view name) const
{
    return _tree->get(_tree->elements[_index].name) == name;
}

int XmlElement::getLine() const
{
    return _tree->elements[_index].line;
}

std::optional<std::string> XmlElement::findAttribute(std::string_view name) const
{
    XmlTree::Element const& element = _tree->elements[_index];
    for (std::uint32_t i = element.firstAttribute; i < element.attributesEnd; ++i)
        if (_tree->get(_tree->attributes[i].name) == name)
            return std::string(_tree->get(_tree->attributes[i].value));
    return std::nullopt;
}

std::string XmlElement::getAttribute(std::string_view name) const
{
    std::optional<std::string> value = findAttribute(name);
    if (!value)
        throw XmlError(__FILE__, __LINE__, getLine(),
                       "element '" + getName() + "' has no attribute " + LiStringUtil::getPrintable(std::string(name)));
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

std::optional<std::string> XmlElement::findOtherAttribute(std::initializer_list<std::string_view> known) const
{
    XmlTree::Element const& element = _tree->elements[_index];
    for (std::uint32_t i = element.firstAttribute; i < element.attributesEnd; ++i)
        if (std::string_view const name = _tree->get(_tree->attributes[i].name);
            std::find(known.begin(), known.end(), name) == known.end())
            return std::string(name);
    return std::nullopt;
}

std::vector<XmlElement> XmlElement::getChildren() const
{
    std::vector<XmlTree::Element> const& elements = _tree->elements;
    std::size_t count = 0;
    for (std::uint32_t i = _index + 1; i < elements[_index].end; i = elements[i].end)
        ++count;
    std::vector<XmlElement> children;
    children.reserve(count);
    for (std::uint32_t i = _index + 1; i < elements[_index].end; i = elements[i].end)
        children.emplace_back(_tree, i);
    return children;
}

std::optional<XmlElement> XmlElement::findChild(std::string_view name) const
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
    std::string_view const text = _tree->get(_tree->elements[_index].text);
    return !std::all_of(text.begin(), text.end(), XmlSyntax::isBlank);
}

} // namespace Kv
