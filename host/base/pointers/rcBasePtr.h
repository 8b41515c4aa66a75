#pragma once

#include "pointers/rcBase.h"
#include "pointers/rcExUtil.h"

#include <ostream>
#include <typeinfo>
#include <utility>

namespace Kv
{

/// What pointers to objects that derive from `RCBase` share: one word, which can be null. Going through a null one
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

} // namespace Kv
