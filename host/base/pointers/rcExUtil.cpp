#include "pointers/rcExUtil.h"

#include <cstdlib>
#include <cxxabi.h>
#include <memory>

namespace Kv
{

ExBase* ExNullPtr::clone() const
{
    return new ExNullPtr(*this);
}

void ExNullPtr::raise() const
{
    throw ExNullPtr(*this);
}

ExBase* ExCastFailed::clone() const
{
    return new ExCastFailed(*this);
}

void ExCastFailed::raise() const
{
    throw ExCastFailed(*this);
}

void RCExUtil::throwExNullPtr(char const* typeName)
{
    throw ExNullPtr(__FILE__, __LINE__, "Null pointer of type " + getReadableTypeName(typeName));
}

void RCExUtil::throwExCastFailed(char const* fromType, char const* toType)
{
    throw ExCastFailed(__FILE__, __LINE__,
                       "Cannot cast " + getReadableTypeName(fromType) + " to " + getReadableTypeName(toType));
}

std::string RCExUtil::getReadableTypeName(char const* typeName)
{
    int status = 0;
    std::unique_ptr<char, decltype(&std::free)> const plain(abi::__cxa_demangle(typeName, nullptr, nullptr, &status),
                                                            &std::free);
    return status == 0 ? plain.get() : typeName;
}

} // namespace Kv
