#pragma once

#include "kvExport.h"
#include "pointers/rcBase.h"
#include "pointers/rcShdPtr.h"

namespace Kv
{

/// A font that widgets draw with.
class KV_API WsFont : public RCBase<LkCounter<int>>
{
public:
    /// Width of a UTF-8 text as a widget draws it, in pixels, rounded up to whole ones. Works without a display too.
    float getStringWidth(char const* text) const;
};

/// The fonts of the process.
class KV_API WsFontRegistry
{
public:
    static WsFontRegistry& getInstance();

    /// The font of widgets that ask for no other.
    RCShdPtr<WsFont> getDefaultFont() const;

private:
    RCShdPtr<WsFont> _defaultFont = makeShd<WsFont>();
};

} // namespace Kv
