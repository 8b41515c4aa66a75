#include "windows/qtWindowWidget.h"

#include "windows/qtFocusOrder.h"

#include <QApplication>
#include <QCloseEvent>
#include <QKeyEvent>
#include <QTimer>

#include <algorithm>
#include <utility>

namespace Kv
{

namespace
{

/// False where windows never cover each other, and the toolkit complains when they are asked to.
bool hasStack()
{
    QString const name = QGuiApplication::platformName();
    return name != QLatin1String("offscreen") && name != QLatin1String("minimal");
}

} // namespace

QtWindowWidget::QtWindowWidget(QtListenerHandle<NtWindowListener> const& handle)
    : QWidget(nullptr, Qt::Dialog | Qt::CustomizeWindowHint | Qt::WindowTitleHint), _handle(handle),
      _area(new QtContentArea(this, [handle](int width, int height)
                              { handle.tell(&NtWindowListener::onResized, width, height); }))
{
    setAttribute(Qt::WA_QuitOnClose, false);
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
    show();
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
    if (QWidget* const modal = QApplication::activeModalWidget())
        modal->activateWindow();
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
    // Not on the screen yet, but with its final size: the first picture is laid out.
    if (_area)
        _area->tellRoom();
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
    if (_area)
        _area->setGeometry(rect());
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

bool QtWindowWidget::focusNextPrevChild(bool next)
{
    return QtFocusOrder(*this).step(next);
}

void QtWindowWidget::unblock(QWidget const& window)
{
    auto const isOf = [&window](std::unique_ptr<QtInputDrop> const& drop) { return drop->isFor(window); };
    _blocked.erase(std::remove_if(_blocked.begin(), _blocked.end(), isOf), _blocked.end());
}

void QtWindowWidget::blockOthers()
{
    // The toolkit's modality stops only what comes from the window system; events can also be sent to a widget.
    _blocked.clear();
    for (QPointer<QtWindowWidget> const& window : findAll())
        if (window != this && window->isVisible())
        {
            window->unblock(*this);
            _blocked.push_back(std::make_unique<QtInputDrop>(*window));
        }
}

} // namespace Kv
