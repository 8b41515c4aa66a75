#include "rttiType.h"

namespace Kv
{

RttiType::RttiType(std::type_info const& info, RttiType const* base) : _info(info), _base(base) {}

bool RttiType::isA(RttiType const& other) const
{
    for (RttiType const* type = this; type; type = type->_base)
        if (type->_info == other._info)
            return true;
    return false;
}

} // namespace Kv
