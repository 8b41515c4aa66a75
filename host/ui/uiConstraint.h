#pragma once

#include "geometry.h"
#include "kvExport.h"
#include "text/liString.h"

#include <array>

namespace Kv
{

/// Says where the four edges of a widget lie. X grows to the right and Y grows upward, so that Y1 is the bottom edge.
class KV_API UiConstraint
{
public:
    /// The measure of a value.
    enum Type
    {
        Pixels = 0,
        /// Layout units, counted alike in both directions ("uu").
        UniformUnits = 2,
        /// Layout units, counted by the grid of their direction ("u").
        Units = 3,
    };

    /// The edge or line that a value is measured from.
    enum Target
    {
        /// The parent's left or bottom edge.
        ParentLow = 0,
        /// The parent's right or top edge.
        ParentHigh = 1,
        /// The widget's own opposite edge: the value is the widget's width or height.
        OwnOpposite = 2,
        /// The edge of the named sibling that faces this one.
        SiblingEdge = 3,
    };

    /// Index of an edge.
    enum EdgeName
    {
        X1,
        Y1,
        X2,
        Y2,
    };

    static constexpr int EdgeCount = 4;

    struct Edge
    {
        float value = 0;
        Type type = Pixels;
        Target target = ParentLow;
        /// The name of the sibling; empty with every other target.
        LiString sibling;

        /// The value in pixels.
        float getPixels() const;
    };

    /// Each group of parameters in the order X1, Y1, X2, Y2.
    UiConstraint(float x1, float y1, float x2, float y2, Type typeX1, Type typeY1, Type typeX2, Type typeY2,
                 Target targetX1, Target targetY1, Target targetX2, Target targetY2, LiString const& siblingX1,
                 LiString const& siblingY1, LiString const& siblingX2, LiString const& siblingY2);

    explicit UiConstraint(std::array<Edge, EdgeCount> edges);
    UiConstraint(UiConstraint const&);
    UiConstraint(UiConstraint&&) noexcept;
    UiConstraint& operator=(UiConstraint const&);
    UiConstraint& operator=(UiConstraint&&) noexcept;
    ~UiConstraint();

    Edge const& getEdge(EdgeName name) const { return _edges[name]; }

    /// Size of a layout unit in pixels, in both directions.
    static GeVector2<float> getUIGrid();

    /// Pixels in layout units, rounded up to whole ones: what takes that many units is never smaller than the pixels.
    static GeVector2<float> pixelsToUIUnits(GeVector2<float> const& pixels);

private:
    std::array<Edge, EdgeCount> _edges;
};

} // namespace Kv
