#pragma once

#include <vector>

namespace Kv
{

/// Row of values.
template <typename T> using Vector = std::vector<T>;

} // namespace Kv
