#include "wsFont.h"

#include "text/liStringUtil.h"
#include "wsNative.h"

namespace Kv
{

float WsFont::getStringWidth(char const* text) const
{
    LiStringUtil::requireUtf8(text, "Text to measure");
    return WsNative::getPlatform().measureText(text);
}

} // namespace Kv
