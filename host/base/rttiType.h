#pragma once

#include <typeinfo>

namespace Kv
{

/// Record of a class and its base. Every library may have a copy of its own, so records compare by `type_info`.
class RttiType
{
public:
    RttiType(std::type_info const& info, RttiType const* base) : _info(info), _base(base) {}

    /// True for the class itself and for classes derived from it.
    bool isA(RttiType const& other) const
    {
        for (RttiType const* type = this; type; type = type->_base)
            if (type->_info == other._info)
                return true;
        return false;
    }

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
