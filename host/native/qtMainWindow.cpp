#include "native/qtMainWindow.h"

#include "native/floatWidget.h"
#include "native/qtInputDrop.h"

#include <QEvent>
#include <QGuiApplication>

#include <utility>

namespace Kv
{

QtMainWindow::QtMainWindow(NtForeignWidget window, std::function<void(bool)> enableOwn, NtWindowListener& listener)
    : _handle(listener), _content(window), _enableOwn(std::move(enableOwn))
{
    if (QWidget* const native = _content.getNative())
        native->installEventFilter(this);
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
    QPointer<QWidget> const holder = _holders.back();
    _holders.pop_back();
    if (_content.getNative() && _holders.empty())
        _enableOwn(true);
    if (!holder)
        return;
    if (holder->isEnabled() && holder->isVisibleTo(holder->window()))
        holder->setFocus(Qt::OtherFocusReason);
    else if (FloatWidget const* const around = FloatWidget::findAround(*holder))
        if (QWidget* const earlier = around->findEarlierHolder())
            earlier->setFocus(Qt::OtherFocusReason);
}

bool QtMainWindow::eventFilter(QObject* watched, QEvent* event)
{
    if (event->type() == QEvent::Resize)
        tellSize();
    return QObject::eventFilter(watched, event);
}

void QtMainWindow::tellSize() const
{
    if (QWidget const* const native = _content.getNative())
        _handle.tell(&NtWindowListener::onResized, native->width(), native->height());
}

} // namespace Kv
