#include "base/inVariableBase.h"

#include <algorithm>

namespace Kv
{

InVariableBase::~InVariableBase() = default;

void InVariableBase::addDependency(InVariableBase* other)
{
    if (std::find(_dependencies.begin(), _dependencies.end(), other) == _dependencies.end())
        _dependencies.push_back(other);
}

void InVariableBase::removeDependency(InVariableBase* other)
{
    _dependencies.erase(std::remove(_dependencies.begin(), _dependencies.end(), other), _dependencies.end());
}

} // namespace Kv
