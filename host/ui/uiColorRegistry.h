#pragma once

#include "coRgbColor.h"
#include "kvExport.h"
#include "text/liString.h"

namespace Kv
{

/// The colours by name.
class KV_API UiColorRegistry
{
public:
    /// "grey65": grey of 65 % of the light of white.
    static LiString const Grey65;

    static UiColorRegistry& getInstance();

    /// Throws an `ExBase` for a name that no colour has.
    CoRgbColorTyped<float> getColor(LiString const& name) const;
};

} // namespace Kv
