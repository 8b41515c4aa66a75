#include "windows/qtWindow.h"

#include "loop/qtGuard.h"
#include "loop/qtInputDrop.h"
#include "peers/qtText.h"
#include "windows/qtWindowIcon.h"
#include "windows/qtWindowWidget.h"

#include <QApplication>
#include <QThread>
#include <QWindow>

namespace Kv
{

namespace
{

/// Closes the menus and lists that are open above a window. They hold the pointer and the keyboard.
void closePopups(QWidget const& window)
{
    for (QWidget* popup = QApplication::activePopupWidget(); popup; popup = QApplication::activePopupWidget())
    {
        QWidget const* owner = popup;
        while (owner && owner != &window)
            owner = owner->parentWidget();
        if (!owner || !popup->close())
            return;
    }
}

/// Once for each application: another one can follow when its owner has destroyed the first.
void goWithApplication()
{
    static QPointer<QCoreApplication> watched;
    if (watched == QCoreApplication::instance())
        return;
    watched = QCoreApplication::instance();
    qAddPostRoutine(&QtWindow::destroyLeft);
}

} // namespace

QtWindow::QtWindow(std::string const& name, std::string const& title, std::string const& contentName,
                   QRect const& frame, QtWindow const* owner, NtWindowListener& listener)
    : _handle(listener), _native(new QtWindowWidget(_handle), name, 0), _owner(owner ? owner->_native.get() : nullptr),
      _content(std::make_unique<QtContainer>(getNative(), contentName))
{
    goWithApplication();
    QtWindowWidget* const native = getNative();
    // No screen shows more, and a window system can end the process for it.
    constexpr int maxTitle = 4096;
    // Doubled, what marks a changed document for Qt stands for itself.
    native->setWindowTitle(toQString(title).left(maxTitle).replace(QLatin1String("[*]"), QLatin1String("[*][*]")));
    // Where the application is a script's own, it has no icon as a rule.
    if (QApplication::windowIcon().isNull())
        native->setWindowIcon(getWindowIcon());
    native->setGeometry(frame);
    native->setContent(_content->getNative());
}

QtWindow::~QtWindow()
{
    _handle.close();
    // Hidden first, as by its owner: another window gets the keyboard. Another thread leaves that to the toolkit.
    if (QWidget const* const native = _native.get(); native && native->thread() == QThread::currentThread())
        hide();
}

void QtWindow::destroyLeft()
{
    for (QPointer<QtWindowWidget> const& window : QtWindowWidget::findAll())
        std::unique_ptr<QWidget> const left(window.data());
}

void QtWindow::setContentSize(int width, int height)
{
    if (QtWindowWidget* const native = getNative())
        native->setContentSize(width, height);
}

void QtWindow::show()
{
    QtWindowWidget* const native = getNative();
    if (!native)
        throw ExBase(__FILE__, __LINE__, "Cannot show a window: it is gone with the application that it belonged to");
    // The native window must be there for the owner to be told of.
    native->winId();
    if (_owner && _owner->windowHandle())
        native->windowHandle()->setTransientParent(_owner->windowHandle());
    native->showModal();
}

void QtWindow::hide()
{
    QtErrorAside const aside;
    QWidget* const native = _native.get();
    if (!native || native->isHidden())
        return;
    closePopups(*native);
    native->hide();
    // Where no window manager does it, the keyboard has to be given back.
    if (_owner && _owner->isVisible())
        _owner->activateWindow();
}

void QtWindow::redraw()
{
    if (QWidget* const native = _native.get())
        native->repaint();
}

void QtWindow::flushInput()
{
    QWidget* const native = _native.get();
    if (!native)
        return;
    QtInputDrop const drop(*native);
    QGuiApplication::sync();
}

QtWindowWidget* QtWindow::getNative() const
{
    return static_cast<QtWindowWidget*>(_native.get());
}

} // namespace Kv
