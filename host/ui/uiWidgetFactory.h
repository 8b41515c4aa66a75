#pragma once

#include "uiContainer.h"
#include "xml/xmlElement.h"

#include <vector>

namespace Kv
{

class UiWidgetElement;

/// Makes a kind of widget known to descriptions. Each kind has one in its own source file.
class UiWidgetKind
{
public:
    /// Builds the widget of an element as the last in `parent`, without its constraint.
    using Build = void (*)(RCShdPtr<UiContainer> const& parent, UiWidgetElement& element);

    /// `element` is the name of the kind's elements.
    UiWidgetKind(char const* element, Build build);
};

/// Builds widgets from the elements of a description.
class KV_API UiWidgetFactory
{
public:
    /// The greatest depth of containers in containers.
    static constexpr int maxDepth = 256;

    /// Builds the widget of `element`, with all that it holds, as the last in `parent`, and gives it.
    /// Throws an `XmlError` that names the line for what is no description; nothing is left in `parent` then.
    static RCShdPtr<UiWidget> createWidget(RCShdPtr<UiContainer> const& parent, XmlElement const& element);

    /// Builds the widgets of a container's `Group` in it.
    static void createGroup(RCShdPtr<UiContainer> const& container, UiWidgetElement& element);

private:
    static void createAll(RCShdPtr<UiContainer> const& container, std::vector<XmlElement> const& elements, int depth);
};

} // namespace Kv
