#include "uiWidgetElement.h"

#include "xml/xmlError.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <initializer_list>
#include <string_view>

namespace Kv
{

namespace
{

[[noreturn]] void fail(XmlElement const& element, std::string const& words)
{
    throw XmlError(__FILE__, __LINE__, element.getLine(), words);
}

void requireNoOtherAttribute(XmlElement const& element, std::initializer_list<std::string_view> known)
{
    if (std::optional<std::string> const name = element.findOtherAttribute(known))
        fail(element, "unknown attribute \"" + *name + "\" of \"" + element.getName() + "\"");
}

/// Refuses text and attributes that an element of this name has no use for.
void requirePlain(XmlElement const& element, std::initializer_list<std::string_view> attributes = {})
{
    if (element.hasText())
        fail(element, "text in the element \"" + element.getName() + "\", which holds none");
    requireNoOtherAttribute(element, attributes);
}

void requireNoChildren(XmlElement const& element)
{
    std::vector<XmlElement> const children = element.getChildren();
    if (!children.empty())
        fail(children.front(),
             "unknown element \"" + children.front().getName() + "\" in \"" + element.getName() + "\"");
}

XmlElement requireOnly(XmlElement const& parent, std::string const& name)
{
    requirePlain(parent);
    std::vector<XmlElement> const children = parent.getChildren();
    for (XmlElement const& child : children)
        if (!child.isNamed(name))
            fail(child, "unknown element \"" + child.getName() + "\" in \"" + parent.getName() + "\"");
    if (children.size() != 1)
        fail(parent, "\"" + parent.getName() + "\" holds " + std::to_string(children.size()) + " elements \"" + name +
                         "\", it must hold one");
    return children.front();
}

int toInt(XmlElement const& element, std::string const& text)
{
    std::size_t const first = text.find_first_not_of(" \t\r\n");
    std::size_t const last = text.find_last_not_of(" \t\r\n");
    int number = 0;
    if (first != std::string::npos)
    {
        char const* const end = text.data() + last + 1;
        std::from_chars_result const result = std::from_chars(text.data() + first, end, number);
        if (result.ec == std::errc() && result.ptr == end)
            return number;
    }
    fail(element, "\"" + text + "\" in \"" + element.getName() + "\" is no whole number");
}

std::string readText(XmlElement const& element)
{
    requireNoOtherAttribute(element, {});
    requireNoChildren(element);
    return element.getText();
}

/// Nothing for a word that is no target of that edge.
std::optional<UiConstraint::Target> findTarget(std::string_view word, UiConstraint::EdgeName edge)
{
    bool const isHorizontal = edge == UiConstraint::X1 || edge == UiConstraint::X2;
    if (word == (isHorizontal ? "l" : "b"))
        return UiConstraint::ParentLow;
    if (word == (isHorizontal ? "r" : "t"))
        return UiConstraint::ParentHigh;
    if (word == (isHorizontal ? "w" : "h"))
        return UiConstraint::OwnOpposite;
    if (word == "s")
        return UiConstraint::SiblingEdge;
    return std::nullopt;
}

UiConstraint::Type readType(XmlElement const& element)
{
    std::string const type = element.getAttribute("Type");
    if (type == "u")
        return UiConstraint::Units;
    if (type == "uu")
        return UiConstraint::UniformUnits;
    fail(element, "unknown Type \"" + type + "\" of \"" + element.getName() + "\": it is \"u\" or \"uu\"");
}

UiConstraint::Edge readEdge(XmlElement const& element, UiConstraint::EdgeName name)
{
    requirePlain(element, {"Value", "Type", "Target", "Sibling"});
    requireNoChildren(element);
    UiConstraint::Edge edge;
    edge.value = static_cast<float>(toInt(element, element.getAttribute("Value")));
    edge.type = readType(element);
    std::string const target = element.getAttribute("Target");
    std::optional<UiConstraint::Target> const known = findTarget(target, name);
    if (!known)
        fail(element, "unknown Target \"" + target + "\" of \"" + element.getName() + "\"");
    edge.target = *known;
    if (edge.target == UiConstraint::SiblingEdge)
        edge.sibling = element.getAttribute("Sibling");
    else if (element.findAttribute("Sibling"))
        fail(element, "\"" + element.getName() + "\" has a Sibling, which goes with Target \"s\" alone");
    return edge;
}

UiConstraint readConstraint(XmlElement const& layout)
{
    XmlElement const constraint = requireOnly(layout, "Constraint");
    requirePlain(constraint);
    constexpr std::array<char const*, UiConstraint::EdgeCount> names{"X1", "Y1", "X2", "Y2"};
    std::array<std::optional<UiConstraint::Edge>, UiConstraint::EdgeCount> edges;
    for (XmlElement const& element : constraint.getChildren())
    {
        auto const name = std::find_if(names.begin(), names.end(),
                                       [&element](char const* candidate) { return element.isNamed(candidate); });
        auto const index = static_cast<std::size_t>(name - names.begin());
        if (name == names.end() || edges.at(index))
            fail(element, "unknown or repeated element \"" + element.getName() + "\" in \"Constraint\"");
        edges.at(index) = readEdge(element, static_cast<UiConstraint::EdgeName>(index));
    }
    for (std::size_t edge = 0; edge < edges.size(); ++edge)
        if (!edges.at(edge))
            fail(constraint, std::string("\"Constraint\" has no \"") + names.at(edge) + "\"");
    return UiConstraint(
        {*edges[UiConstraint::X1], *edges[UiConstraint::Y1], *edges[UiConstraint::X2], *edges[UiConstraint::Y2]});
}

} // namespace

UiWidgetElement::UiWidgetElement(XmlElement const& element, int depth)
    : _element(element), _depth(depth), _parts(element.getChildren())
{
    requirePlain(element);
    std::optional<XmlElement> const widget = take(_parts, "Widget");
    if (!widget)
        fail(element, "\"" + element.getName() + "\" has no \"Widget\"");
    requirePlain(*widget, {"Name"});
    _name = widget->getAttribute("Name");
    _properties = widget->getChildren();
    std::optional<XmlElement> const layout = take(_properties, "Layout");
    if (!layout)
        fail(*widget, "the widget \"" + _name + "\" has no \"Layout\"");
    _constraint = readConstraint(*layout);
}

std::optional<std::string> UiWidgetElement::takeLabelString()
{
    std::optional<XmlElement> const label = take(_properties, "LabelString");
    if (!label)
        return std::nullopt;
    return readText(requireOnly(*label, "Text"));
}

std::vector<std::string> UiWidgetElement::takeTexts(std::string const& name)
{
    std::vector<std::string> texts;
    std::optional<XmlElement> const list = take(_properties, name);
    if (!list)
        return texts;
    requirePlain(*list);
    for (XmlElement const& text : list->getChildren())
    {
        if (!text.isNamed("Text"))
            fail(text, "unknown element \"" + text.getName() + "\" in \"" + name + "\"");
        texts.push_back(readText(text));
    }
    return texts;
}

std::optional<int> UiWidgetElement::takeInt(std::string const& name)
{
    std::optional<XmlElement> const holder = take(_properties, name);
    if (!holder)
        return std::nullopt;
    XmlElement const number = requireOnly(*holder, "Int");
    return toInt(number, readText(number));
}

NtAlign UiWidgetElement::takeAlign(NtAlign otherwise)
{
    std::optional<XmlElement> const holder = take(_properties, "LabelAlign");
    if (!holder)
        return otherwise;
    XmlElement const align = requireOnly(*holder, "Align");
    requirePlain(align, {"H", "V"});
    requireNoChildren(align);
    if (std::string const vertical = align.getAttribute("V"); vertical != "Center")
        fail(align, "unknown V \"" + vertical + "\" of \"Align\": it is \"Center\"");
    std::string const horizontal = align.getAttribute("H");
    if (horizontal == "Left")
        return NtAlign::Left;
    if (horizontal == "Center")
        return NtAlign::Center;
    fail(align, "unknown H \"" + horizontal + "\" of \"Align\": it is \"Left\" or \"Center\"");
}

std::vector<XmlElement> UiWidgetElement::takeGroup()
{
    std::optional<XmlElement> const group = take(_parts, "Group");
    if (!group)
        return {};
    requirePlain(*group, {"Type"});
    if (std::string const type = group->getAttribute("Type"); type != "Children")
        fail(*group, "unknown Type \"" + type + "\" of \"Group\": it is \"Children\"");
    return group->getChildren();
}

void UiWidgetElement::finish() const
{
    for (std::vector<XmlElement> const* const left : {&_parts, &_properties})
        if (!left->empty())
            fail(left->front(), "unknown or repeated element \"" + left->front().getName() + "\" in the " +
                                    _element.getName() + " \"" + _name + "\"");
}

std::optional<XmlElement> UiWidgetElement::take(std::vector<XmlElement>& from, std::string const& name)
{
    auto const found =
        std::find_if(from.begin(), from.end(), [&name](XmlElement const& element) { return element.isNamed(name); });
    if (found == from.end())
        return std::nullopt;
    XmlElement element = *found;
    from.erase(found);
    return element;
}

} // namespace Kv
