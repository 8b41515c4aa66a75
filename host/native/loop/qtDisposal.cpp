#include "loop/qtDisposal.h"

#include "start/qtApplication.h"

#include <QCoreApplication>
#include <QPointer>
#include <QThread>

#include <memory>
#include <utility>
#include <vector>

namespace Kv
{

namespace
{

/// Never destroyed: peers go as late as the last objects of the interpreter do.
std::vector<QPointer<QWidget>>& getWaiting()
{
    static auto* const waiting = new std::vector<QPointer<QWidget>>;
    return *waiting;
}

} // namespace

QtMoment QtWindowLike::getMomentMade(QWidget const& widget)
{
    for (QWidget const* around = &widget; around; around = around->parentWidget())
        if (auto const* const windowLike = dynamic_cast<QtWindowLike const*>(around))
            return windowLike->_made;
    return {};
}

void QtDisposal::destroy(QWidget* widget)
{
    QtErrorAside const aside;
    // Without its application a widget can no longer be touched.
    if (!widget || !QtApplication::isThere())
        return;
    if (widget->thread() != QThread::currentThread())
    {
        widget->deleteLater();
        return;
    }
    if (QtGuard::getInstance().getMoment() == QtWindowLike::getMomentMade(*widget))
    {
        std::unique_ptr<QWidget> const done(widget);
        return;
    }
    // Nothing may come out of an end. What fails leaves the widget to its parent, hidden and unheard.
    QtGuard::getInstance().shield(
        [widget]
        {
            widget->hide();
            widget->deleteLater();
            getWaiting().emplace_back(widget);
        });
}

void QtDisposal::destroyWaiting()
{
    if (!QtGuard::getInstance().isIdle() || !QtApplication::isThere())
        return;
    for (QPointer<QWidget> const& widget : std::exchange(getWaiting(), {}))
        if (widget)
            QCoreApplication::sendPostedEvents(widget, QEvent::DeferredDelete);
}

} // namespace Kv
