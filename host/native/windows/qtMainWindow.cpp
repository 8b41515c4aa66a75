#include "windows/qtMainWindow.h"

#include "loop/qtGuard.h"
#include "loop/qtInputDrop.h"
#include "windows/qtFloat.h"
#include "windows/qtFrontOrder.h"

#include <QApplication>
#include <QEvent>

#include <utility>

namespace Kv
{

QtMainWindow::QtMainWindow(NtForeignWidget window, std::function<void(bool)> enableOwn, NtWindowListener& listener)
    : _handle(listener), _content(window), _enableOwn(std::move(enableOwn))
{
    if (QWidget* const native = _content.getNative())
        native->installEventFilter(this);
    connect(qApp, &QApplication::focusChanged, this, [this](QWidget*, QWidget* to) { onFocusChanged(to); });
}

QtMainWindow::~QtMainWindow()
{
    _handle.close();
}

void QtMainWindow::show()
{
    QWidget* const native = _content.getNative();
    if (!native)
        return;
    native->show();
    native->activateWindow();
    tellSize();
}

void QtMainWindow::hide()
{
    if (QWidget* const native = _content.getNative())
        native->hide();
}

void QtMainWindow::redraw()
{
    if (QWidget* const native = _content.getNative())
        native->repaint();
}

void QtMainWindow::flushInput()
{
    if (QWidget* const native = _content.getNative())
        QtInputDrop::flush(*native);
}

void QtMainWindow::refuseInput()
{
    QWidget* const native = _content.getNative();
    _placesWithKeyboard.emplace_back(findPlaceWithKeyboard());
    if (!native)
        return;
    try
    {
        // Else Qt gives the keyboard to another widget, and the float forgets this one.
        native->setFocus(Qt::OtherFocusReason);
        if (_placesWithKeyboard.size() == 1)
            _enableOwn(false);
    }
    catch (...)
    {
        admitInput();
        throw;
    }
}

void QtMainWindow::admitInput() noexcept
{
    QtErrorAside const aside;
    QPointer<QWidget> const place = _placesWithKeyboard.back();
    _placesWithKeyboard.pop_back();
    QWidget* const native = _content.getNative();
    if (!native)
        return;
    QtGuard& guard = QtGuard::getInstance();
    if (_placesWithKeyboard.empty())
        guard.shield([this] { _enableOwn(true); });
    guard.shield(
        [&]
        {
            if (!QtFrontOrder::giveKeyboard(place))
                QtFrontOrder::getInstance().settleKeyboard(*native);
        });
}

bool QtMainWindow::eventFilter(QObject* watched, QEvent* event)
{
    if (event->type() == QEvent::Resize)
        tellSize();
    return QObject::eventFilter(watched, event);
}

void QtMainWindow::onFocusChanged(QWidget* to)
{
    QWidget const* const native = _content.getNative();
    if (!to)
        // Later: Qt is in the middle of taking it from what is disabled.
        QMetaObject::invokeMethod(
            this, [this] { restoreLostKeyboard(); }, Qt::QueuedConnection);
    else if (to != native && to->window() == native && !QtFloat::findAround(*to))
        QtFrontOrder::getInstance().rememberKeyboard(*to);
}

void QtMainWindow::restoreLostKeyboard() const
{
    QWidget* const native = _content.getNative();
    if (native && native->isActiveWindow() && !native->focusWidget())
        QtFrontOrder::getInstance().settleKeyboard(*native);
}

QWidget* QtMainWindow::findPlaceWithKeyboard() const
{
    QWidget const* const native = _content.getNative();
    QWidget* const focused = native ? native->focusWidget() : nullptr;
    if (!focused || focused == native)
        return nullptr;
    QtFloat* const floating = QtFloat::findAround(*focused);
    return floating ? floating : focused;
}

void QtMainWindow::tellSize() const
{
    if (QWidget const* const native = _content.getNative())
        _handle.tell(&NtWindowListener::onResized, native->width(), native->height());
}

} // namespace Kv
