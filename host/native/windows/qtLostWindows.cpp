#include "windows/qtLostWindows.h"

#include "windows/qtWindow.h"

#include <QCoreApplication>
#include <QPointer>

#include <xcb/xcb.h>

namespace Kv
{

void QtLostWindows::watch()
{
    // Never destroyed: the application object can come and go. Installed again, it is there once.
    static auto* const watcher = new QtLostWindows;
    QCoreApplication::instance()->installNativeEventFilter(watcher);
}

bool QtLostWindows::nativeEventFilter(QByteArray const& kind, void* message, qintptr*)
{
    auto const* const event = static_cast<xcb_generic_event_t const*>(message);
    constexpr int sentByOthers = 0x80;
    if (kind != "xcb_generic_event_t" || (event->response_type & ~sentByOthers) != XCB_DESTROY_NOTIFY)
        return false;
    auto const lost = static_cast<xcb_destroy_notify_event_t const*>(message)->window;
    for (QPointer<QtWindowWidget> const& window : QtWindowWidget::findAll())
        if (window->internalWinId() == lost)
            window->deleteLater();
    return false;
}

} // namespace Kv
