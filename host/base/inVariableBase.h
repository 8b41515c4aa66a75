#pragma once

#include "base/kvExport.h"

#include <vector>

namespace Kv
{

/// What has to be set up in an order: knows what must be ready before it. Borrows what it depends on.
class KV_API InVariableBase
{
public:
    InVariableBase() = default;
    InVariableBase(InVariableBase const&) = delete;
    InVariableBase& operator=(InVariableBase const&) = delete;
    virtual ~InVariableBase();

    /// Has `other` set up first. Once is enough.
    virtual void addDependency(InVariableBase* other);

    /// Takes back `addDependency`, as before `other` goes.
    virtual void removeDependency(InVariableBase* other);

    /// Name for people, valid as long as this lives.
    virtual char const* getName() const = 0;

    std::vector<InVariableBase*> const& getDependencies() const { return _dependencies; }

private:
    std::vector<InVariableBase*> _dependencies;
};

} // namespace Kv
