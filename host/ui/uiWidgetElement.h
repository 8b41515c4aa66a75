#pragma once

#include "kvExport.h"
#include "ntPeer.h"
#include "uiConstraint.h"
#include "xml/xmlElement.h"

#include <optional>
#include <string>
#include <vector>

namespace Kv
{

/// One widget element of a description, taken apart. A widget takes what it knows; what is left over at the end is a
/// mistake of the description. Every fault is an `XmlError` that names the line.
class KV_API UiWidgetElement
{
public:
    /// `depth` is 1 for the root of the description, and one more for each container that the widget stands in.
    UiWidgetElement(XmlElement const& element, int depth);

    int getDepth() const { return _depth; }

    /// The line of the description that it begins in, from 1.
    int getLine() const { return _element.getLine(); }

    std::string const& getName() const { return _name; }

    UiConstraint const& getConstraint() const { return *_constraint; }

    /// The text of `LabelString`, if there is one.
    std::optional<std::string> takeLabelString();

    /// The texts of the element of that name, none if it is not there.
    std::vector<std::string> takeTexts(std::string const& name);

    /// The whole number of the element of that name, if there is one.
    std::optional<int> takeInt(std::string const& name);

    /// `H` of `LabelAlign`; `otherwise` if there is none.
    NtAlign takeAlign(NtAlign otherwise);

    /// The widget elements of `Group`.
    std::vector<XmlElement> takeGroup();

    /// Throws for what nobody took.
    void finish() const;

private:
    static std::optional<XmlElement> take(std::vector<XmlElement>& from, std::string const& name);

    XmlElement _element;
    int _depth;
    std::string _name;
    std::optional<UiConstraint> _constraint;
    /// The parts of the element, and of its `Widget`, that nobody has taken yet.
    std::vector<XmlElement> _parts;
    std::vector<XmlElement> _properties;
};

} // namespace Kv
