#pragma once

#include <memory>

namespace Kv
{

/// Pointer that owns its object alone; as a parameter it takes the object over.
template <typename T> using OPtr = std::unique_ptr<T>;

} // namespace Kv
