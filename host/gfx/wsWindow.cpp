#include "wsWindow.h"

#include <utility>

namespace Kv
{

WsWindow::WsWindow(std::unique_ptr<NtWindow> native) : _native(std::move(native)) {}

WsWindow::~WsWindow() = default;

void WsWindow::flushAllEvents()
{
    _native->flushInput();
}

} // namespace Kv
