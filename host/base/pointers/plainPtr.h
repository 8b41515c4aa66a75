#pragma once

#include "pointers/rcExUtil.h"

#include <memory>

namespace Kv
{

/// Pointer that owns its object alone; as a parameter it takes the object over.
template <typename T> using OPtr = std::unique_ptr<T>;

/// Borrowed pointer that can be null. Going through a null one throws `ExNullPtr`.
template <typename T> class UPtr
{
public:
    UPtr() = default;
    UPtr(T* object) : _object(object) {}

    /// Null for a null pointer.
    T* get() const { return _object; }

    bool isNull() const { return !_object; }

    T* operator->() const { return requireObject(_object); }
    T& operator*() const { return *requireObject(_object); }

private:
    T* _object = nullptr;
};

} // namespace Kv
