#include "gfx/wsFont.h"

#include "gfx/wsNative.h"
#include "resmgt/liStringUtil.h"

namespace Kv
{

float WsFont::getStringWidth(char const* text) const
{
    LiStringUtil::requireUtf8(text, "Text to measure");
    return WsNative::getPlatform().measureText(text);
}

} // namespace Kv
