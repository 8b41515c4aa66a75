#include "peers/qtPointerWatch.h"

#include <QMouseEvent>

namespace Kv
{

QtPointerWatch::QtPointerWatch(QWidget& widget, NtPointerListener& listener) : _handle(listener)
{
    widget.setMouseTracking(true);
    widget.installEventFilter(this);
}

QtPointerWatch::~QtPointerWatch()
{
    _handle.close();
}

bool QtPointerWatch::eventFilter(QObject* watched, QEvent* event)
{
    auto const& widget = static_cast<QWidget const&>(*watched);
    auto const mouse = [event]() -> QMouseEvent const& { return static_cast<QMouseEvent const&>(*event); };
    auto const isLeft = [&mouse] { return mouse().button() == Qt::LeftButton; };
    switch (event->type())
    {
    case QEvent::MouseMove:
        tell(&NtPointerListener::onPointerMoved, widget, mouse(), mouse().buttons().testFlag(Qt::LeftButton));
        return true;
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonDblClick:
        if (isLeft())
            tell(&NtPointerListener::onPointerDown, widget, mouse());
        return true;
    case QEvent::MouseButtonRelease:
        if (isLeft())
            tell(&NtPointerListener::onPointerUp, widget, mouse());
        return true;
    default:
        return false;
    }
}

template <typename Method, typename... Args>
void QtPointerWatch::tell(Method what, QWidget const& widget, QMouseEvent const& event, Args const&... args) const
{
    QPoint const place = widget.window()->mapFromGlobal(event.globalPosition().toPoint());
    _handle.tell(what, place.x(), place.y(), args...);
}

} // namespace Kv
