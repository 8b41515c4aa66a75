#include "uiApplication.h"

#include "wsNative.h"

namespace Kv
{

UiApplication* UiApplication::getInstance()
{
    static UiApplication application;
    return &application;
}

void UiApplication::localMessageLoop(bool const volatile* until, bool volatile* end)
{
    WsNative::getPlatform().runLoop(until, end);
}

} // namespace Kv
