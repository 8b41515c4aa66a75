#pragma once

#include "kvExport.h"
#include "pointers/rcBase.h"

namespace Kv
{

/// A font that widgets draw with.
class KV_API WsFont : public RCBase<LkCounter<int>>
{
public:
    /// Width of a UTF-8 text as a widget draws it, in pixels, rounded up to whole ones. Works without a display too.
    float getStringWidth(char const* text) const;
};

} // namespace Kv
