#include "windows/qtWindow.h"

#include "loop/qtDisposal.h"
#include "loop/qtGuard.h"
#include "loop/qtInputDrop.h"
#include "loop/qtSpareHandles.h"
#include "peers/qtText.h"
#include "start/qtApplication.h"
#include "windows/qtLostWindows.h"
#include "windows/qtWindowIcon.h"

#include <QApplication>
#include <QCloseEvent>
#include <QKeyEvent>
#include <QThread>
#include <QTimer>
#include <QWindow>

#include <algorithm>

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
    QtLostWindows::watch();
}

/// False where windows never cover each other, and Qt complains when they are asked to.
bool hasStack()
{
    QString const name = QGuiApplication::platformName();
    return name != QLatin1String("offscreen") && name != QLatin1String("minimal");
}

constexpr qsizetype mostInWaylandTitle = 1024;

bool isWayland()
{
    return QGuiApplication::platformName().startsWith(QLatin1String("wayland"));
}

/// Widens a window for its title where it is Qt that draws that, in the middle between an icon and three buttons, and
/// cuts what has no room.
void makeRoomForTitle(QWidget& window)
{
    if (!isWayland() || window.windowHandle()->frameMargins().isNull())
        return;
    constexpr int fontHeight = 14;
    constexpr int buttons = 80;
    constexpr int enough = 480;
    QFont font = QGuiApplication::font();
    font.setPixelSize(fontHeight);
    int const wanted = QFontMetrics(font).horizontalAdvance(window.windowTitle()) + 2 * buttons;
    QMargins const frame = window.windowHandle()->frameMargins();
    int const room = window.screen()->availableGeometry().width() - frame.left() - frame.right();
    window.resize(std::max(window.width(), std::min({wanted, room, enough})), window.height());
}

} // namespace

QtWindowWidget::QtWindowWidget(QtListenerHandle<NtWindowListener> const& handle)
    : QWidget(nullptr, Qt::Dialog | Qt::CustomizeWindowHint | Qt::WindowTitleHint), _handle(handle),
      _area(new QtContentArea(this, [handle](int width, int height)
                              { return handle.tell(&NtWindowListener::onResized, width, height); }))
{
    setAttribute(Qt::WA_QuitOnClose, false);
    // Left and right are what descriptions say, whatever direction the user reads in.
    setLayoutDirection(Qt::LeftToRight);
}

QtWindowWidget::~QtWindowWidget()
{
    // Wayland has those that belong to a window asked to close with it, one in which a dialog runs too.
    QtGuard::getInstance().shield(
        [own = windowHandle()]
        {
            for (QWindow* const other : QGuiApplication::topLevelWindows())
                if (own && other->transientParent() == own)
                    other->setTransientParent(own->transientParent());
        });
}

std::vector<QPointer<QtWindowWidget>> QtWindowWidget::findAll()
{
    std::vector<QPointer<QtWindowWidget>> windows;
    for (QWidget* const widget : QApplication::topLevelWidgets())
        if (auto* const window = dynamic_cast<QtWindowWidget*>(widget))
            windows.emplace_back(window);
    return windows;
}

void QtWindowWidget::showModal()
{
    _awaited = true;
    // A visible window keeps its modality, and its place below those that were shown after it.
    if (QApplication::activeModalWidget() != this)
        hide();
    setWindowModality(Qt::ApplicationModal);
    QtGuard::getInstance().carry([this] { layOut(); });
    show();
    makeRoomForTitle(*this);
    comeToFront();
}

void QtWindowWidget::comeToFront()
{
    if (hasStack())
        raise();
    else
        QApplication::setActiveWindow(this);
    activateWindow();
}

void QtWindowWidget::stopWaiting()
{
    _awaited = false;
    QTimer::singleShot(0, this, [this] { letOthersIn(); });
}

void QtWindowWidget::letOthersIn()
{
    if (_awaited || !isVisible())
        return;
    hide();
    setWindowModality(Qt::NonModal);
    setAttribute(Qt::WA_ShowWithoutActivating);
    show();
    setAttribute(Qt::WA_ShowWithoutActivating, false);
    QWidget* const modal = QApplication::activeModalWidget();
    if (auto* const awaited = dynamic_cast<QtWindowWidget*>(modal))
        awaited->comeBack();
    else if (modal)
        modal->activateWindow();
}

void QtWindowWidget::comeBack()
{
    // Wayland has no other way to put a window in front again.
    if (isWayland())
    {
        hide();
        show();
    }
    comeToFront();
}

void QtWindowWidget::setContentSize(int width, int height)
{
    if (_area)
        _area->setContentSize(width, height);
}

void QtWindowWidget::showEvent(QShowEvent* event)
{
    QWidget::showEvent(event);
    if (!event->spontaneous() && isModal())
        blockOthers();
    layOut();
}

void QtWindowWidget::hideEvent(QHideEvent* event)
{
    QWidget::hideEvent(event);
    // The window manager's minimizing is no end.
    if (event->spontaneous())
        return;
    _blocked.clear();
    if (_area)
        _area->forgetRoom();
}

void QtWindowWidget::resizeEvent(QResizeEvent* event)
{
    QWidget::resizeEvent(event);
    layOut();
}

void QtWindowWidget::closeEvent(QCloseEvent* event)
{
    event->ignore();
    _handle.tell(&NtWindowListener::onCloseRequested);
}

void QtWindowWidget::keyPressEvent(QKeyEvent* event)
{
    if (event->key() != Qt::Key_Escape)
    {
        QWidget::keyPressEvent(event);
        return;
    }
    event->accept();
    if (!event->isAutoRepeat())
        _handle.tell(&NtWindowListener::onEscape);
}

void QtWindowWidget::layOut()
{
    if (_area)
        _area->fill(rect());
}

void QtWindowWidget::unblock(QWidget const& window)
{
    auto const isOf = [&window](std::unique_ptr<QtInputDrop> const& drop) { return drop->isFor(window); };
    _blocked.erase(std::remove_if(_blocked.begin(), _blocked.end(), isOf), _blocked.end());
}

void QtWindowWidget::blockOthers()
{
    // Qt's modality stops only what comes from the window system; events can also be sent to a widget.
    _blocked.clear();
    for (QPointer<QtWindowWidget> const& window : findAll())
        if (window != this && window->isVisible())
        {
            window->unblock(*this);
            _blocked.push_back(std::make_unique<QtInputDrop>(*window));
        }
}

QtWindow::QtWindow(std::string const& name, std::string const& title, std::string const& contentName,
                   QRect const& frame, QtWindow const* owner, NtWindowListener& listener)
    : _handle(listener), _widget(new QtWindowWidget(_handle)), _owner(owner ? owner->getNative() : nullptr)
{
    goWithApplication();
    QtWindowWidget* const native = getNative();
    native->setObjectName(toQString(name));
    NtNoListener nobody;
    _content = std::make_unique<QtContainer>(native, contentName, nobody);
    // A window system can end the process for a longer one, and Qt complains of it on Wayland.
    qsizetype const most = isWayland() ? mostInWaylandTitle : mostInRow;
    // Doubled, what marks a changed document for Qt stands for itself.
    native->setWindowTitle(toShown(toQString(title), most).replace(QLatin1String("[*]"), QLatin1String("[*][*]")));
    // Where the application is a script's own, it has no icon as a rule.
    if (QApplication::windowIcon().isNull())
        native->setWindowIcon(getWindowIcon());
    native->setGeometry(frame);
    native->setContent(_content->getNative());
}

QtWindow::~QtWindow()
{
    _handle.close();
    // Hidden first, as by its owner: another window gets the keyboard. Another thread leaves that to Qt.
    if (QWidget const* const native = getNative(); native && native->thread() == QThread::currentThread())
        hide();
    _content.reset();
    QtDisposal::destroy(_widget);
}

void QtWindow::destroyLeft()
{
    if (!QtApplication::isThere())
        return;
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
    QtSpareHandles::Turn const turn;
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
    QtSpareHandles::Turn const turn;
    QtErrorAside const aside;
    QWidget* const native = getNative();
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
    QtSpareHandles::Turn const turn;
    if (QWidget* const native = getNative())
        native->repaint();
}

void QtWindow::flushInput()
{
    QtSpareHandles::Turn const turn;
    if (QWidget* const native = getNative())
        QtInputDrop::flush(*native);
}

QtWindowWidget* QtWindow::getNative() const
{
    return QtApplication::isThere() ? _widget.data() : nullptr;
}

} // namespace Kv
