#pragma once

#include "base/rcExUtil.h"

#include <typeinfo>

namespace Kv
{

/// Borrowed pointer that can be null. Going through a null one throws `ExNullPtr`.
template <typename T> class UPtr
{
public:
    UPtr() = default;
    UPtr(T* object) : _object(object) {}

    /// Null for a null pointer.
    T* get() const { return _object; }

    bool isNull() const { return !_object; }

    T* operator->() const { return checked(); }
    T& operator*() const { return *checked(); }

private:
    T* checked() const
    {
        if (!_object)
            RCExUtil::throwExNullPtr(typeid(T*).name());
        return _object;
    }

    T* _object = nullptr;
};

} // namespace Kv
