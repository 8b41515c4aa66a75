#pragma once

#include "uiContainer.h"
#include "xml/xmlElement.h"

#include <vector>

namespace Kv
{

/// Builds widgets from the elements of a description.
class KV_API UiWidgetFactory
{
public:
    /// How deep containers may stand in each other.
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
