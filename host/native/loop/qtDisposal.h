#pragma once

#include "loop/qtGuard.h"

#include <QWidget>

namespace Kv
{

/// A window or a floating container. Remembers when it was made: Qt cannot be busy with a widget that goes in the very
/// call in which its window came.
class QtWindowLike
{
public:
    QtWindowLike() = default;
    QtWindowLike(QtWindowLike const&) = delete;
    QtWindowLike& operator=(QtWindowLike const&) = delete;
    virtual ~QtWindowLike() = default;

    /// The moment when the innermost of them around a widget was made, the widget itself included.
    static QtMoment getMomentMade(QWidget const& widget);

private:
    QtMoment _made = QtGuard::getInstance().getMoment();
};

/// The end of widgets with which Qt may be busy.
class QtDisposal
{
public:
    /// Destroys a widget that its owner has done with, as soon as that can be: at once, or when the call from Qt that
    /// is under way has returned, or on the widget's own thread. Nothing happens for null.
    static void destroy(QWidget* widget);

    /// Destroys the widgets that had to wait, where no call from Qt is under way any more.
    static void destroyWaiting();
};

} // namespace Kv
