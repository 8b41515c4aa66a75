#include "native/qtMainWindow.h"

#include "native/floatWidget.h"
#include "native/qtGuard.h"
#include "native/qtInputDrop.h"

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
    QWidget* const native = _content.getNative();
    if (!native)
        return;
    QtInputDrop const drop(*native);
    QGuiApplication::sync();
}

void QtMainWindow::refuseInput()
{
    QWidget const* const native = _content.getNative();
    _holders.emplace_back(native ? native->focusWidget() : nullptr);
    if (native && _holders.size() == 1)
        _enableOwn(false);
}

void QtMainWindow::admitInput()
{
    QtErrorAside const aside;
    QPointer<QWidget> const holder = _holders.back();
    if (_content.getNative() && _holders.size() == 1)
        _enableOwn(true);
    _holders.pop_back();
    giveKeyboard(holder);
}

bool QtMainWindow::eventFilter(QObject* watched, QEvent* event)
{
    if (event->type() == QEvent::Resize)
        tellSize();
    else if (event->type() == FloatWidget::getHiddenEvent())
        giveKeyboard(static_cast<QWidget*>(watched)->focusWidget());
    return QObject::eventFilter(watched, event);
}

void QtMainWindow::onFocusChanged(QWidget* to)
{
    // While input is refused the toolkit moves the keyboard on its own.
    if (to && _holders.empty() && to->window() == _content.getNative() && !FloatWidget::findAround(*to))
        _home = to;
}

void QtMainWindow::giveKeyboard(QWidget* holder) const
{
    for (QWidget* const candidate : {holder, _home.data()})
        if (candidate && candidate->isEnabled() && candidate->isVisibleTo(candidate->window()))
        {
            candidate->setFocus(Qt::OtherFocusReason);
            return;
        }
}

void QtMainWindow::tellSize() const
{
    if (QWidget const* const native = _content.getNative())
        _handle.tell(&NtWindowListener::onResized, native->width(), native->height());
}

} // namespace Kv
