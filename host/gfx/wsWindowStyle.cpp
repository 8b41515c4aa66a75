#include "wsWindowStyle.h"

namespace Kv
{

RCShdPtr<WsWindowStyle> WsWindowStyleUtils::getNormalWindowStyle(GeRectangle<int> const& frame, int, BorderStyle,
                                                                 TitleBarStyle, TaskBarStyle, StackingStyle,
                                                                 CloseButtonStyle)
{
    return makeShd<WsWindowStyle>(frame);
}

} // namespace Kv
