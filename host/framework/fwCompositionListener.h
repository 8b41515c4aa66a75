#pragma once

#include "base/kvExport.h"

namespace Kv
{

class FwComposition;

/// Hears what happens to a composition, after it has happened.
class KV_API FwCompositionListener
{
public:
    FwCompositionListener() = default;
    FwCompositionListener(FwCompositionListener const&) = delete;
    FwCompositionListener& operator=(FwCompositionListener const&) = delete;
    virtual ~FwCompositionListener();

    virtual void compositionChanged(FwComposition const& composition) = 0;
    virtual void compositionSaved(FwComposition const& composition) = 0;
};

} // namespace Kv
