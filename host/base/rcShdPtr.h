#pragma once

#include "base/rcBase.h"
#include "base/rcExUtil.h"

#include <cstddef>
#include <type_traits>
#include <typeinfo>
#include <utility>

namespace Kv
{

/// Strong pointer, one word wide, to an object that derives from `RCBase`. Can be null; going through a null one
/// throws `ExNullPtr`.
template <typename T> class RCShdPtr
{
public:
    using element_type = T;

    RCShdPtr() = default;
    RCShdPtr(std::nullptr_t) {}
    RCShdPtr(T* object) : _object(object) { acquire(); }
    RCShdPtr(RCShdPtr const& other) : _object(other._object) { acquire(); }
    RCShdPtr(RCShdPtr&& other) noexcept : _object(std::exchange(other._object, nullptr)) {}
    template <typename U, typename = std::enable_if_t<std::is_convertible_v<U*, T*>>>
    RCShdPtr(RCShdPtr<U> const& other) : _object(other.get())
    {
        acquire();
    }
    ~RCShdPtr() { reset(); }

    RCShdPtr& operator=(RCShdPtr other) noexcept
    {
        std::swap(_object, other._object);
        return *this;
    }

    /// Lets the object go; the pointer is null before a destructor runs.
    void reset()
    {
        if (T* const object = std::exchange(_object, nullptr))
            object->releaseReference();
    }

    /// Borrowed; null for a null pointer.
    T* get() const { return _object; }

    bool isNull() const { return !_object; }
    explicit operator bool() const { return _object; }

    T* operator->() const { return checked(); }
    T& operator*() const { return *checked(); }

    friend bool operator==(RCShdPtr const& a, RCShdPtr const& b) { return a._object == b._object; }
    friend bool operator!=(RCShdPtr const& a, RCShdPtr const& b) { return a._object != b._object; }

private:
    void acquire() const
    {
        if (_object)
            _object->addReference();
    }

    T* checked() const
    {
        if (!_object)
            RCExUtil::throwExNullPtr(typeid(T*).name());
        return _object;
    }

    T* _object = nullptr;
};

/// A new counted object and the first pointer to it.
template <typename T, typename... Args> RCShdPtr<T> makeShd(Args&&... args)
{
    return RCShdPtr<T>(new T(std::forward<Args>(args)...));
}

/// The same object under the type `To`; null where it is none, or for a null pointer.
template <typename To, typename From> RCShdPtr<To> dynamicCast(RCShdPtr<From> const& pointer)
{
    return RCShdPtr<To>(dynamic_cast<To*>(pointer.get()));
}

} // namespace Kv
