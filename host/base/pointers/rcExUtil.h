#pragma once

#include "exBase.h"

#include <string>
#include <typeinfo>

namespace Kv
{

/// Thrown by going through a null counted pointer.
class KV_API ExNullPtr : public ExBase
{
public:
    using ExBase::ExBase;
    ExBase* clone() const override;
    [[noreturn]] void raise() const override;
};

/// Thrown by a cast that the object's type does not allow.
class KV_API ExCastFailed : public ExBase
{
public:
    using ExBase::ExBase;
    ExBase* clone() const override;
    [[noreturn]] void raise() const override;
};

/// The failures that all counted pointers share.
class KV_API RCExUtil
{
public:
    /// Throws `ExNullPtr`. `typeName` is the pointer's type, mangled or plain; the words hold it in plain form.
    [[noreturn]] static void throwExNullPtr(char const* typeName);

    /// Throws `ExCastFailed` for two type names, mangled or plain.
    [[noreturn]] static void throwExCastFailed(char const* fromType, char const* toType);

    /// The plain form of a type name, mangled or plain.
    static std::string getReadableTypeName(char const* typeName);
};

/// The object itself; throws `ExNullPtr` with the pointer's type for none. What every pointer goes through.
template <typename T> T* requireObject(T* object)
{
    if (!object)
        RCExUtil::throwExNullPtr(typeid(T*).name());
    return object;
}

} // namespace Kv
