#include "wsFont.h"

#include "text/liString.h"
#include "wsNative.h"

namespace Kv
{

float WsFont::getStringWidth(char const* text) const
{
    LiStringUtil::requireUtf8(text, "Text to measure");
    return WsNative::getPlatform().measureText(text);
}

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
