#include "native/qtPointerWatch.h"

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
    auto const isLeft = [event] { return static_cast<QMouseEvent const*>(event)->button() == Qt::LeftButton; };
    switch (event->type())
    {
    case QEvent::MouseMove:
        tell(&NtPointerListener::onPointerMoved, widget, static_cast<QMouseEvent const&>(*event));
        return true;
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonDblClick:
        if (isLeft())
            tell(&NtPointerListener::onPointerDown, widget, static_cast<QMouseEvent const&>(*event));
        return true;
    case QEvent::MouseButtonRelease:
        if (isLeft())
            tell(&NtPointerListener::onPointerUp, widget, static_cast<QMouseEvent const&>(*event));
        return true;
    default:
        return false;
    }
}

void QtPointerWatch::tell(void (NtPointerListener::*what)(int, int), QWidget const& widget,
                          QMouseEvent const& event) const
{
    QPoint const place = widget.window()->mapFromGlobal(event.globalPosition().toPoint());
    _handle.tell(what, place.x(), place.y());
}

} // namespace Kv
