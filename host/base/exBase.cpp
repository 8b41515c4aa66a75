#include "base/exBase.h"

#include <utility>

namespace Kv
{

ExBase::ExBase(char const* sourcePath, int line, std::string reason)
    : _reason(std::move(reason)), _detailedReason(_reason + " (" + sourcePath + ":" + std::to_string(line) + ")")
{
}

ExBase::~ExBase() = default;

char const* ExBase::what() const noexcept
{
    return _reason.c_str();
}

char const* ExBase::getReason() const
{
    return _reason.c_str();
}

char const* ExBase::getDetailedReason() const
{
    return _detailedReason.c_str();
}

ExBase* ExBase::clone() const
{
    return new ExBase(*this);
}

void ExBase::raise() const
{
    throw ExBase(*this);
}

} // namespace Kv
