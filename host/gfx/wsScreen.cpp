#include "wsScreen.h"

#include "wsNative.h"

namespace Kv
{

WsScreen& WsScreen::getInstance()
{
    static WsScreen screen;
    return screen;
}

GeVector2<int> WsScreen::getSize() const
{
    return WsNative::getPlatform().getScreenSize();
}

} // namespace Kv
