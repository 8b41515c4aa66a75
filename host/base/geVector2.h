#pragma once

namespace Kv
{

/// Pair of numbers: a point, a size or a factor in two directions.
template <typename Number> struct GeVector2
{
    Number x{};
    Number y{};
};

} // namespace Kv
