#pragma once

#include "pointers/rcExUtil.h"
#include "pointers/rcWeakPtr.h"

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
