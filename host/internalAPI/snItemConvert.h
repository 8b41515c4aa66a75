#pragma once

namespace Kv
{

/// How items of a selection become what `T` points to. Each library that has a kind of item specializes it, with two
/// static operations: `getPredicate`, which holds for the items of that kind, and `get`, which gives what such an item
/// stands for, and null for any other.
template <typename T> class SnItemConvert;

} // namespace Kv
