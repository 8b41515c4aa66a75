#pragma once

#include "uiContainer.h"

#include <optional>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

namespace Kv
{

/// Works out the rectangles of the widgets directly in one container from their constraints. The cost grows with the
/// number of widgets, in whatever order they hang on each other.
class UiLayout
{
public:
    /// A constraint that leads nowhere.
    struct Fault
    {
        /// Place of the widget among its siblings.
        std::size_t child;
        std::string words;
    };

    /// By how much the widgets in a container, at any depth, stand out of it as they are placed now, or lack of width,
    /// in pixels.
    static GeVector2<int> measureOverflow(UiContainer const& container);

    explicit UiLayout(UiContainer const& container);

    /// The first constraint that names a sibling which is not there, or that hangs on itself.
    std::optional<Fault> findFault();

    /// Gives the widgets, and those in them, their rectangles. A widget without a constraint stays where it is.
    void apply();

private:
    using EdgeIndex = std::size_t;

    static constexpr EdgeIndex nowhere = static_cast<EdgeIndex>(-1);

    enum class Progress
    {
        Untouched,
        UnderWay,
        Settled,
    };

    void keepInPlace(std::size_t child);
    UiConstraint::Edge const& getEdge(EdgeIndex edge) const;
    EdgeIndex findBase(EdgeIndex edge) const;
    std::optional<Fault> settle(EdgeIndex edge);
    float place(EdgeIndex edge, EdgeIndex base) const;

    GeRectangle<int> _frame;
    std::vector<RCShdPtr<UiWidget>> const& _children;
    std::unordered_map<std::string, std::size_t> _places;
    std::vector<float> _positions;
    std::vector<Progress> _progress;
    /// The edges that the one being settled hangs on, each with the one that it is measured from.
    std::vector<std::pair<EdgeIndex, EdgeIndex>> _chain;
};

} // namespace Kv
