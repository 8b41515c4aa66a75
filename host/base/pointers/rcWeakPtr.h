#pragma once

#include "pointers/rcStrongPtr.h"

#include <memory>
#include <type_traits>

namespace Kv
{

/// Weak pointer to an object that strong pointers hold by their control block. It is expired when there is no object,
/// or no longer one; `RCWeakAccessor` goes through it.
template <typename T> class RCWeakPtr
{
public:
    RCWeakPtr() = default;
    template <typename U, typename = std::enable_if_t<std::is_convertible_v<U*, T*>>>
    RCWeakPtr(RCStrongPtr<U> const& object) : _object(object.getShared())
    {
    }
    /// The way to a virtual base leads through the object itself, which is held for that long; an expired pointer gives
    /// an expired one.
    template <typename U, typename = std::enable_if_t<std::is_convertible_v<U*, T*>>>
    RCWeakPtr(RCWeakPtr<U> const& other) : _object(std::shared_ptr<T>(other.lock()))
    {
    }

    bool isExpired() const { return _object.expired(); }

    /// Holds the object; null for an expired pointer.
    std::shared_ptr<T> lock() const { return _object.lock(); }

    /// Whether both point to one object, or did so before it went.
    friend bool operator==(RCWeakPtr const& a, RCWeakPtr const& b)
    {
        return !a._object.owner_before(b._object) && !b._object.owner_before(a._object);
    }
    friend bool operator!=(RCWeakPtr const& a, RCWeakPtr const& b) { return !(a == b); }

private:
    std::weak_ptr<T> _object;
};

} // namespace Kv
