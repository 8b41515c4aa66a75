#pragma once

#include "pointers/rcShdPtr.h"

#include <utility>

namespace Kv
{

/// Pointer of a handle to its engine. Copies of the handle share one engine until one of them is about to change it.
/// Going through a null one throws `ExNullPtr`.
template <typename Engine> class RCPvtEngPtr
{
public:
    RCPvtEngPtr() = default;
    explicit RCPvtEngPtr(RCShdPtr<Engine> engine) : _engine(std::move(engine)) {}

    /// The engine to be looked at, shared or not.
    Engine const* operator->() const { return _engine.operator->(); }

    /// The engine to be changed; where others have it too, this pointer takes a clone first.
    Engine& makeOwn()
    {
        if (_engine->getReferenceCount() != 1)
            _engine = _engine->clone();
        return *_engine;
    }

private:
    RCShdPtr<Engine> _engine;
};

} // namespace Kv
