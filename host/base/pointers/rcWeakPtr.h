#pragma once

#include "pointers/rcExUtil.h"

#include <cstddef>
#include <memory>
#include <type_traits>
#include <typeinfo>
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

    /// True if both point to one object, or did so before it went.
    friend bool operator==(RCWeakPtr const& a, RCWeakPtr const& b)
    {
        return !a._object.owner_before(b._object) && !b._object.owner_before(a._object);
    }
    friend bool operator!=(RCWeakPtr const& a, RCWeakPtr const& b) { return !(a == b); }

private:
    std::weak_ptr<T> _object;
};

/// Holds the object of a weak pointer for as long as it lives. It is empty if that was expired; going through an empty
/// one throws `ExNullPtr`.
template <typename T> class RCWeakAccessor
{
public:
    explicit RCWeakAccessor(RCWeakPtr<T> const& pointer) : _object(pointer.lock()) {}

    bool isNull() const { return !_object; }

    T* operator->() const { return requireObject(_object.get()); }
    T& operator*() const { return *requireObject(_object.get()); }

    /// The object under the type `To`. Throws `ExCastFailed` where it is none, and `ExNullPtr` where it is expired.
    template <typename To> RCWeakPtr<To> castTo() const
    {
        requireObject(_object.get());
        RCStrongPtr<To> const object(std::dynamic_pointer_cast<To>(_object));
        if (object.isNull())
            RCExUtil::throwExCastFailed(typeid(T*).name(), typeid(To*).name());
        return object;
    }

private:
    std::shared_ptr<T> _object;
};

} // namespace Kv
