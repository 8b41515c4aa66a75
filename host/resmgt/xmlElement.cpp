#include "resmgt/xmlElement.h"

#include "resmgt/liStringUtil.h"
#include "resmgt/xmlError.h"
#include "resmgt/xmlSyntax.h"
#include "resmgt/xmlTree.h"

#include <cstring>
#include <utility>

namespace Kv
{

namespace
{

bool isText(pugi::xml_node node)
{
    return node.type() == pugi::node_pcdata || node.type() == pugi::node_cdata;
}

} // namespace

XmlElement::XmlElement(std::shared_ptr<XmlTree const> tree, pugi::xml_node_struct* node)
    : _tree(std::move(tree)), _node(node)
{
}

std::string XmlElement::getName() const
{
    return pugi::xml_node(_node).name();
}

int XmlElement::getLine() const
{
    return _tree->getLine(pugi::xml_node(_node).name());
}

std::optional<std::string> XmlElement::findAttribute(std::string const& name) const
{
    pugi::xml_attribute const attribute = pugi::xml_node(_node).attribute(name.c_str());
    return attribute ? std::optional<std::string>(attribute.value()) : std::nullopt;
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
    for (pugi::xml_attribute const attribute : pugi::xml_node(_node).attributes())
        names.emplace_back(attribute.name());
    return names;
}

std::vector<XmlElement> XmlElement::getChildren() const
{
    std::vector<XmlElement> children;
    for (pugi::xml_node const child : pugi::xml_node(_node))
        if (child.type() == pugi::node_element)
            children.emplace_back(_tree, child.internal_object());
    return children;
}

std::optional<XmlElement> XmlElement::findChild(std::string const& name) const
{
    for (pugi::xml_node const child : pugi::xml_node(_node))
        if (child.type() == pugi::node_element && name == child.name())
            return XmlElement(_tree, child.internal_object());
    return std::nullopt;
}

std::string XmlElement::getText() const
{
    std::string text;
    for (pugi::xml_node const child : pugi::xml_node(_node))
        if (isText(child))
            text += child.value();
    return text;
}

bool XmlElement::hasText() const
{
    for (pugi::xml_node const child : pugi::xml_node(_node))
        if (isText(child) && child.value()[std::strspn(child.value(), XmlSyntax::blanks)] != '\0')
            return true;
    return false;
}

} // namespace Kv
