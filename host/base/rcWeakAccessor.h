#pragma once

#include "base/rcExUtil.h"
#include "base/rcWeakPtr.h"

#include <memory>
#include <typeinfo>

namespace Kv
{

/// Holds the object of a weak pointer for as long as it lives. It is empty if that was expired; going through an empty
/// one throws `ExNullPtr`.
template <typename T> class RCWeakAccessor
{
public:
    explicit RCWeakAccessor(RCWeakPtr<T> const& pointer) : _object(pointer.lock()) {}

    bool isNull() const { return !_object; }

    T* operator->() const { return checked().get(); }
    T& operator*() const { return *checked(); }

    /// The object under the type `To`. Throws `ExCastFailed` where it is none, and `ExNullPtr` where it is expired.
    template <typename To> RCWeakPtr<To> castTo() const
    {
        RCStrongPtr<To> const object(std::dynamic_pointer_cast<To>(checked()));
        if (object.isNull())
            RCExUtil::throwExCastFailed(typeid(T*).name(), typeid(To*).name());
        return object;
    }

private:
    std::shared_ptr<T> const& checked() const
    {
        if (!_object)
            RCExUtil::throwExNullPtr(typeid(T*).name());
        return _object;
    }

    std::shared_ptr<T> _object;
};

} // namespace Kv
