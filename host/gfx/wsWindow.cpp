#include "wsWindow.h"

#include <utility>

namespace Kv
{

RCShdPtr<WsWindowStyle> WsWindowStyleUtils::getNormalWindowStyle(GeRectangle<int> const& frame, int, BorderStyle,
                                                                 TitleBarStyle, TaskBarStyle, StackingStyle,
                                                                 CloseButtonStyle)
{
    return makeShd<WsWindowStyle>(frame);
}

WsWindow::WsWindow(std::unique_ptr<NtWindow> native) : _native(std::move(native)) {}

WsWindow::~WsWindow() = default;

void WsWindow::flushAllEvents()
{
    _native->flushInput();
}

} // namespace Kv
