#include "start/qtPlatform.h"

#include "loop/qtDisposal.h"
#include "loop/qtLoop.h"
#include "loop/qtSpareHandles.h"
#include "loop/qtWayOut.h"
#include "peers/qtPeer.h"
#include "peers/qtText.h"
#include "start/qtTextEstimate.h"
#include "windows/qtAdoptedContainer.h"
#include "windows/qtContentArea.h"
#include "windows/qtFloat.h"
#include "windows/qtFrontOrder.h"
#include "windows/qtMainWindow.h"
#include "windows/qtWindow.h"

#include <QApplication>
#include <QClipboard>
#include <QFontMetricsF>
#include <QScreen>
#include <QStyle>
#include <QStyleHints>

#include <algorithm>
#include <cmath>
#include <utility>
#include <vector>

namespace Kv
{

namespace
{

/// The size that layouts reckon with where there is no screen to ask.
constexpr GeVector2<int> assumedScreen{1920, 1080};

/// Watches those objects in a tree whose addresses are among `wanted`, and adds them to `found`.
void findObjects(QObject* root, std::unordered_set<void const*> const& wanted,
                 std::function<void(void const*)> const& onGone, std::unordered_set<void const*>& found)
{
    if (!root)
        return;
    if (wanted.count(root) > 0 && found.insert(root).second)
        QObject::connect(root, &QObject::destroyed, [onGone, root] { onGone(root); });
    for (QObject* const child : root->children())
        findObjects(child, wanted, onGone, found);
}

/// The widest line as it is drawn, with what its first and last glyph let stick out.
double measureIn(QFont const& font, QString const& text)
{
    QFontMetricsF const metrics(font);
    double width = metrics.size(Qt::TextExpandTabs, text).width();
    for (QString const& line : text.split(QLatin1Char('\n')))
    {
        QRectF const ink = metrics.tightBoundingRect(line);
        width = std::max({width, metrics.horizontalAdvance(line), ink.right()});
    }
    // Qt's own size hints come from the metrics in whole pixels.
    return std::max<double>(width, QFontMetrics(font).size(0, text).width());
}

double measure(QString const& text)
{
    QFont const labelFont = QApplication::font("QLabel");
    QFont const buttonFont = QApplication::font("QPushButton");
    double const width = measureIn(labelFont, text);
    return buttonFont == labelFont ? width : std::max(width, measureIn(buttonFont, text));
}

/// The height that is left free for the window manager's frame, which is known only when it is too late.
constexpr int titleBarRoom = 40;

/// Null where there is none to see windows on. A window system that has none for now gives one without extent.
QScreen const* findScreen()
{
    QScreen const* const screen = QGuiApplication::primaryScreen();
    return screen && !screen->geometry().isEmpty() ? screen : nullptr;
}

/// Turns a frame over, makes it fit the free part of the screen and moves it there.
QRect fitToScreen(GeRectangle<int> const& frame)
{
    QScreen const* const screen = findScreen();
    if (!screen)
        return {frame.xMin, 0, frame.getWidth(), frame.getHeight()};
    QRect const all = screen->geometry();
    QRect const room = screen->availableGeometry();
    int const highest = std::max(1, room.height() - titleBarRoom);
    // The scroll bar of what is cut one way has a place of its own the other way: else it would bring the other bar
    // too.
    int const bar = QApplication::style()->pixelMetric(QStyle::PM_ScrollBarExtent);
    int const barBeside = frame.getHeight() > highest ? bar : 0;
    int const barBelow = frame.getWidth() > room.width() ? bar : 0;
    int const width = std::clamp(frame.getWidth() + barBeside, 1, room.width());
    int const height = std::clamp(frame.getHeight() + barBelow, 1, highest);
    int const x = all.x() + frame.xMin;
    int const y = all.y() + all.height() - frame.yMax;
    return {std::clamp(x, room.x(), room.x() + room.width() - width),
            std::clamp(y, room.y(), room.y() + room.height() - height - titleBarRoom / 2), width, height};
}

} // namespace

QtPlatform::QtPlatform()
{
    QtContentArea::noticeReaders();
    QtSpareHandles::reserve();
}

void QtPlatform::setScriptHook(NtScriptHook* hook)
{
    QtGuard::getInstance().setScriptHook(hook);
}

float QtPlatform::measureText(std::string const& text)
{
    QString const string = toQString(text);
    double const width = _application.hasGui() ? measure(toShown(string)) : estimateTextWidth(string);
    return static_cast<float>(std::ceil(width));
}

bool QtPlatform::hasDisplay()
{
    return QtWayOut::findLoss().empty();
}

GeVector2<int> QtPlatform::getScreenSize()
{
    QScreen const* const screen = _application.hasGui() ? findScreen() : nullptr;
    if (!screen)
        return assumedScreen;
    return {screen->size().width(), screen->size().height()};
}

void QtPlatform::setCursor(NtCursor cursor)
{
    bool const getsBusy = cursor == NtCursor::Busy;
    // The normal cursor needs no application: one that began for it would stand in the way of a script's next.
    if ((getsBusy ? !_application.hasGui() : !_busyApplication) || !QtApplication::isThere())
        return;
    QCoreApplication* const application = QCoreApplication::instance();
    bool const isBusy = _busyApplication == application;
    if (isBusy == getsBusy)
        return;
    if (getsBusy)
        QGuiApplication::setOverrideCursor(Qt::WaitCursor);
    else
        QGuiApplication::restoreOverrideCursor();
    _busyApplication = getsBusy ? application : nullptr;
}

std::unique_ptr<NtWindow> QtPlatform::createWindow(std::string const& name, std::string const& title,
                                                   std::string const& contentName, GeRectangle<int> const& frame,
                                                   NtWindow* owner, NtWindowListener& listener)
{
    _application.requireWindows();
    return std::make_unique<QtWindow>(name, title, contentName, fitToScreen(frame), dynamic_cast<QtWindow*>(owner),
                                      listener);
}

std::unique_ptr<NtMainWindow> QtPlatform::adoptWindow(NtForeignWidget window, std::function<void(bool)> enableOwn,
                                                      NtWindowListener& listener)
{
    _application.requireWindows();
    _adopted = static_cast<QWidget*>(window.widget);
    return std::make_unique<QtMainWindow>(window, std::move(enableOwn), listener);
}

std::unique_ptr<NtContainer> QtPlatform::adoptContainer(NtForeignWidget widget, NtPlaceListener& listener)
{
    return std::make_unique<QtAdoptedContainer>(widget, listener);
}

std::unique_ptr<NtPeer> QtPlatform::createPeer(std::type_index face, NtContainer& parent, std::string const& name,
                                               void* listener)
{
    return QtPeerKinds::make(face, dynamic_cast<QtPeer&>(parent).getContent(), name, listener);
}

void QtPlatform::callNextTurn(std::function<void()> call)
{
    if (QCoreApplication* const application = QCoreApplication::instance())
        QMetaObject::invokeMethod(
            application, [call = std::move(call)] { QtGuard::getInstance().run(call); }, Qt::QueuedConnection);
}

void QtPlatform::runLoop(bool const volatile* until, bool volatile* end)
{
    if (*until)
        return;
    _application.requireLoop();
    if (_closed)
        refuseLoop();
    QPointer<QtWindowWidget> const window = dynamic_cast<QtWindowWidget*>(QApplication::activeModalWidget());
    QWidget const* const stage = window ? window.data() : static_cast<QWidget*>(QtFrontOrder::getInstance().getFront());
    std::exception_ptr error;
    try
    {
        QtSpareHandles::Turn const turn;
        QtSpareHandles::require();
        QtLoop loop(until, end);
        // Where somebody destroys what runs, nobody could end it any more.
        if (stage)
            loop.endWith(*stage);
        error = loop.run();
    }
    catch (...)
    {
        error = QtGuard::getInstance().getScriptHook().capture();
    }
    QtDisposal::destroyWaiting();
    if (!error)
        return;
    if (window)
        window->stopWaiting();
    QtGuard::getInstance().getScriptHook().rethrow(error);
}

bool QtPlatform::isLoopOver()
{
    QtLoop const* const loop = QtGuard::getInstance().getInnermostLoop();
    return loop && loop->isOver();
}

void QtPlatform::callScript(std::function<void()> const& call)
{
    QtSpareHandles::Pause const pause;
    call();
}

void QtPlatform::actForScript(std::function<void()> const& call)
{
    QtSpareHandles::Turn const turn;
    call();
}

void QtPlatform::refuseLoop()
{
    // A script that asks until it gets an answer would go on for ever, with no window to end it by.
    constexpr int patience = 10;
    if (++_refusedLoops > patience)
        QtGuard::getInstance().getScriptHook().interrupt();
    throw ExBase(__FILE__, __LINE__, "The application is closing: no dialog can be run any more");
}

int QtPlatform::runApplication(std::function<void()> lastAct)
{
    QtSpareHandles::Turn const turn;
    int status = 0;
    QtWayOut::setLastAct(std::move(lastAct));
    std::string const loss = QtWayOut().run([&status] { status = QApplication::exec(); });
    QtWayOut::setLastAct(nullptr);
    if (!loss.empty())
        throw ExBase(__FILE__, __LINE__, "Cannot go on: " + loss);
    return status;
}

void QtPlatform::endLoop()
{
    if (QtLoop* const loop = QtGuard::getInstance().getInnermostLoop())
        loop->end();
}

void QtPlatform::interruptLoop()
{
    if (QtGuard::getInstance().getInnermostLoop())
        QtGuard::getInstance().checkSignals();
}

void QtPlatform::closeLoops()
{
    _closed = true;
    QtGuard::getInstance().endLoops();
}

void QtPlatform::destroyWindows()
{
    QtWindow::destroyLeft();
}

void QtPlatform::observe(std::unordered_set<void const*>& objects, std::function<void(void const*)> const& onGone)
{
    if (objects.empty())
        return;
    std::vector<QObject*> roots{_adopted.data()};
    for (QPointer<QtWindowWidget> const& window : QtWindowWidget::findAll())
        roots.push_back(window);
    if (_application.isOwn())
        roots.insert(roots.end(), {QCoreApplication::instance(), QGuiApplication::clipboard(),
                                   QGuiApplication::styleHints(), QGuiApplication::primaryScreen()});
    std::unordered_set<void const*> found;
    for (QObject* const root : roots)
        findObjects(root, objects, onGone, found);
    objects = std::move(found);
}

} // namespace Kv

Kv::NtPlatform& kvNativePlatform()
{
    // Never destroyed: the interpreter's last objects still use it.
    static auto* const platform = new Kv::QtPlatform;
    return *platform;
}
