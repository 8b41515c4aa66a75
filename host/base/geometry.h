#pragma once

namespace Kv
{

/// Pair of numbers: a point, a size or a factor in two directions.
template <typename Number> struct GeVector2
{
    Number x{};
    Number y{};
};

/// Rectangle by its edges. Y grows upward: `yMax` is the top edge.
template <typename Number> struct GeRectangle
{
    Number xMin{};
    Number xMax{};
    Number yMin{};
    Number yMax{};

    Number getWidth() const { return xMax - xMin; }
    Number getHeight() const { return yMax - yMin; }

    friend bool operator==(GeRectangle const& a, GeRectangle const& b)
    {
        return a.xMin == b.xMin && a.xMax == b.xMax && a.yMin == b.yMin && a.yMax == b.yMax;
    }
};

} // namespace Kv
