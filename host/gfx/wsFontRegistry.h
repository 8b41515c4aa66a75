#pragma once

#include "pointers/rcShdPtr.h"
#include "wsFont.h"

namespace Kv
{

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
