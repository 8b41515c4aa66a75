#pragma once

#include "pointers/rcBase.h"
#include "pointers/rcExUtil.h"

#include <cstddef>
#include <ostream>
#include <type_traits>
#include <typeinfo>
#include <utility>

namespace Kv
{

/// The base of pointers to objects that derive from `RCBase`: one word, which can be null. Going through a null one
/// throws `ExNullPtr`. Counting is left to the class derived from it.
template <typename T> class RCBasePtr
{
public:
    using element_type = T;

    /// Borrowed; null for a null pointer.
    T* get() const { return _object; }

    bool isNull() const { return !_object; }
    explicit operator bool() const { return _object; }

    T* operator->() const { return requireObject(_object); }
    T& operator*() const { return *requireObject(_object); }

    /// Writes one line for whoever looks for a fault, without its end: the types, the count and the addresses.
    void dump(std::ostream& stream) const;

protected:
    RCBasePtr() = default;
    explicit RCBasePtr(T* object) : _object(object) {}
    RCBasePtr(RCBasePtr const&) = default;
    RCBasePtr& operator=(RCBasePtr const&) = default;
    ~RCBasePtr() = default;

    /// The object, which this pointer is rid of.
    T* detach() { return std::exchange(_object, nullptr); }

    void swap(RCBasePtr& other) { std::swap(_object, other._object); }

private:
    T* _object = nullptr;
};

template <typename T> void RCBasePtr<T>::dump(std::ostream& stream) const
{
    RCBase<LkCounter<int>> const* const base = _object;
    stream << "Pointee type = " << (_object ? RCExUtil::getReadableTypeName(typeid(*_object).name()) : "null")
           << ", T type = " << RCExUtil::getReadableTypeName(typeid(T).name())
           << ", ref: " << (base ? base->getReferenceCount() : 0) << ", pointer:" << static_cast<void const*>(_object)
           << ", RCBase pointer: " << static_cast<void const*>(base);
}

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
