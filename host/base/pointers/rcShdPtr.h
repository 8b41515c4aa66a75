#pragma once

#include "pointers/rcBasePtr.h"

#include <cstddef>
#include <type_traits>
#include <utility>

namespace Kv
{

/// Strong pointer, one word wide, to an object that derives from `RCBase`. Can be null; going through a null one
/// throws `ExNullPtr`.
template <typename T> class RCShdPtr : public RCBasePtr<T>
{
public:
    RCShdPtr() = default;
    RCShdPtr(std::nullptr_t) {}
    RCShdPtr(T* object) : RCBasePtr<T>(object) { acquire(); }
    RCShdPtr(RCShdPtr const& other) : RCBasePtr<T>(other) { acquire(); }
    RCShdPtr(RCShdPtr&& other) noexcept : RCBasePtr<T>(other.detach()) {}
    template <typename U, typename = std::enable_if_t<std::is_convertible_v<U*, T*>>>
    RCShdPtr(RCShdPtr<U> const& other) : RCBasePtr<T>(other.get())
    {
        acquire();
    }
    ~RCShdPtr() { reset(); }

    RCShdPtr& operator=(RCShdPtr other) noexcept
    {
        this->swap(other);
        return *this;
    }

    /// Lets the object go; the pointer is null before a destructor runs.
    void reset()
    {
        if (T* const object = this->detach())
            object->releaseReference();
    }

    friend bool operator==(RCShdPtr const& a, RCShdPtr const& b) { return a.get() == b.get(); }
    friend bool operator!=(RCShdPtr const& a, RCShdPtr const& b) { return a.get() != b.get(); }

private:
    void acquire() const
    {
        if (T* const object = this->get())
            object->addReference();
    }
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
