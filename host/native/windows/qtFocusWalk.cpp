#include "windows/qtFocusWalk.h"

#include <QCoreApplication>
#include <QEvent>
#include <QScrollArea>

#include <utility>

namespace Kv
{

namespace
{

/// True for the content of a scroll area: all in it moves alike.
bool isScrolled(QWidget const& widget)
{
    QWidget const* const viewport = widget.parentWidget();
    auto const* const area = viewport ? qobject_cast<QScrollArea const*>(viewport->parentWidget()) : nullptr;
    return area && area->widget() == &widget;
}

} // namespace

bool QtFocusWalk::step(bool next)
{
    if (!_order || !_order->leadsOn())
        findOrder();
    return _order->step(next);
}

bool QtFocusWalk::eventFilter(QObject* watched, QEvent* event)
{
    if (watched->isWidgetType() && changesOrder(*static_cast<QWidget*>(watched), *event))
        forgetOrder();
    return false;
}

void QtFocusWalk::findOrder()
{
    _order.emplace(_root);
    QCoreApplication::instance()->installEventFilter(this);
    if (!std::exchange(_forgetting, true))
        QMetaObject::invokeMethod(
            this,
            [this]
            {
                _forgetting = false;
                forgetOrder();
            },
            Qt::QueuedConnection);
}

void QtFocusWalk::forgetOrder()
{
    QCoreApplication::instance()->removeEventFilter(this);
    _order.reset();
}

bool QtFocusWalk::changesOrder(QWidget const& widget, QEvent const& event) const
{
    switch (event.type())
    {
    case QEvent::Show:
    case QEvent::ShowToParent:
        return true;
    case QEvent::EnabledChange:
        return widget.isEnabled();
    case QEvent::Move:
        return _root.isAncestorOf(&widget) && !isScrolled(widget);
    case QEvent::Resize:
        return _root.isAncestorOf(&widget);
    default:
        return false;
    }
}

} // namespace Kv
