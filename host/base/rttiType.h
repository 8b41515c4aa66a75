#pragma once

#include "kvExport.h"

#include <typeinfo>

namespace Kv
{

/// Record of a class and its base. Every library may have a copy of its own, so records compare by `type_info`.
class KV_API RttiType
{
public:
    RttiType(std::type_info const& info, RttiType const* base);

    /// True for the class itself and for classes derived from it.
    bool isA(RttiType const& other) const;

private:
    std::type_info const& _info;
    RttiType const* _base;
};

/// The record of a class without a recorded base.
template <typename T> class RttiGenType0
{
public:
    static RttiType const& getInstance()
    {
        static RttiType const record(typeid(T), nullptr);
        return record;
    }
};

/// The record of a class with one recorded base, which gives its own record through `Base::getClassType`.
template <typename T, typename Base> class RttiGenType1
{
public:
    static RttiType const& getInstance()
    {
        static RttiType const record(typeid(T), &Base::getClassType());
        return record;
    }
};

} // namespace Kv
