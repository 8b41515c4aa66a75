#include "loop/qtInputDrop.h"

#include "loop/qtWayOut.h"

#include <QEvent>
#include <QGuiApplication>

namespace Kv
{

namespace
{

bool isInput(QEvent::Type type)
{
    switch (type)
    {
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonRelease:
    case QEvent::MouseButtonDblClick:
    case QEvent::MouseMove:
    case QEvent::KeyPress:
    case QEvent::KeyRelease:
    case QEvent::Shortcut:
    case QEvent::ShortcutOverride:
    case QEvent::InputMethod:
    case QEvent::Wheel:
    case QEvent::ContextMenu:
    case QEvent::TouchBegin:
    case QEvent::TouchUpdate:
    case QEvent::TouchEnd:
    case QEvent::TouchCancel:
    case QEvent::TabletPress:
    case QEvent::TabletMove:
    case QEvent::TabletRelease:
    case QEvent::NativeGesture:
    case QEvent::DragEnter:
    case QEvent::DragMove:
    case QEvent::Drop:
    case QEvent::Close:
        return true;
    default:
        return false;
    }
}

/// True for a window that is no part of the one it belongs to, as a popup is.
bool standsAlone(QObject const& object)
{
    auto const* const widget = qobject_cast<QWidget const*>(&object);
    return widget && widget->isWindow() && widget->windowType() != Qt::Popup;
}

} // namespace

QtInputDrop::QtInputDrop(QWidget& window) : _window(&window)
{
    QCoreApplication::instance()->installEventFilter(this);
}

void QtInputDrop::flush(QWidget& window)
{
    QtInputDrop const drop(window);
    QtWayOut(0).run(&QGuiApplication::sync);
}

bool QtInputDrop::eventFilter(QObject* receiver, QEvent* event)
{
    if (!isInput(event->type()) || !isOfWindow(receiver))
        return false;
    // An accepted request would close the window.
    if (event->type() == QEvent::Close)
        event->ignore();
    return true;
}

bool QtInputDrop::isOfWindow(QObject const* receiver) const
{
    QObject const* object = receiver;
    while (object && !standsAlone(*object))
        object = object->parent();
    return object && object == _window;
}

} // namespace Kv
