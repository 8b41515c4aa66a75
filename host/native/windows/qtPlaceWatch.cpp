#include "windows/qtPlaceWatch.h"

#include <QEvent>

namespace Kv
{

QtPlaceWatch::QtPlaceWatch(QWidget& widget, NtPlaceListener& listener) : _handle(listener), _widget(&widget)
{
    // What holds the widget moves it too.
    for (QWidget* around = &widget; around; around = around->parentWidget())
        around->installEventFilter(this);
    tell();
}

QtPlaceWatch::~QtPlaceWatch()
{
    _handle.close();
}

bool QtPlaceWatch::eventFilter(QObject* watched, QEvent* event)
{
    if (event->type() == QEvent::Resize || event->type() == QEvent::Move || event->type() == QEvent::Show)
        tell();
    return QObject::eventFilter(watched, event);
}

void QtPlaceWatch::tell()
{
    if (!_widget)
        return;
    QPoint const corner = _widget->mapTo(_widget->window(), QPoint(0, 0));
    int const top = _widget->window()->height() - corner.y();
    GeRectangle<int> const place{corner.x(), corner.x() + _widget->width(), top - _widget->height(), top};
    if (_told == place)
        return;
    _told = place;
    _handle.tell(&NtPlaceListener::onPlaced, place);
}

} // namespace Kv
