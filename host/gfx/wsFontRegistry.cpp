#include "wsFontRegistry.h"

namespace Kv
{

WsFontRegistry& WsFontRegistry::getInstance()
{
    static WsFontRegistry registry;
    return registry;
}

RCShdPtr<WsFont> WsFontRegistry::getDefaultFont() const
{
    return _defaultFont;
}

} // namespace Kv
