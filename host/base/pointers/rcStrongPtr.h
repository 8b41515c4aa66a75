#pragma once

#include "pointers/rcExUtil.h"

#include <cstddef>
#include <memory>
#include <type_traits>
#include <utility>

namespace Kv
{

/// Strong pointer whose count stands in a control block beside the object, so that an object of any type can be held,
/// also while weak pointers watch it. Going through a null one throws `ExNullPtr`.
template <typename T> class RCStrongPtr
{
public:
    RCStrongPtr() = default;
    RCStrongPtr(std::nullptr_t) {}
    template <typename U> RCStrongPtr(std::shared_ptr<U> object) : _object(std::move(object)) {}
    template <typename U, typename = std::enable_if_t<std::is_convertible_v<U*, T*>>>
    RCStrongPtr(RCStrongPtr<U> const& other) : _object(other.getShared())
    {
    }

    /// Borrowed; null for a null pointer.
    T* get() const { return _object.get(); }

    bool isNull() const { return !_object; }
    std::shared_ptr<T> const& getShared() const { return _object; }

    T* operator->() const { return requireObject(_object.get()); }
    T& operator*() const { return *requireObject(_object.get()); }

private:
    std::shared_ptr<T> _object;
};

/// A new object and the first strong pointer to it.
template <typename T, typename... Args> RCStrongPtr<T> makeStrong(Args&&... args)
{
    return std::make_shared<T>(std::forward<Args>(args)...);
}

} // namespace Kv
