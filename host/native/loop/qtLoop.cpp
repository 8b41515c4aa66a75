#include "loop/qtLoop.h"

#include "exBase.h"
#include "loop/qtReceiver.h"
#include "loop/qtWayOut.h"

#include <QAbstractEventDispatcher>
#include <QEvent>
#include <QGuiApplication>
#include <QPointer>
#include <QThread>

#include <chrono>

namespace Kv
{

namespace
{

/// The time that Ctrl-C, and a flag that is set without an event, can stay unseen.
constexpr std::chrono::milliseconds tickInterval(50);

/// Hears that the application is asked to quit. Qt does not tell where it is not the application that runs the loop.
class QuitWatch final : public QObject
{
public:
    QuitWatch() { QCoreApplication::instance()->installEventFilter(this); }

    bool eventFilter(QObject* receiver, QEvent* event) override
    {
        if (receiver != QCoreApplication::instance() || event->type() != QEvent::Quit)
            return false;
        QtGuard::getInstance().endLoops();
        return true;
    }
};

/// Runs a loop in one of the application's own, which forgets an exit that was asked for before it began: remembered,
/// it would end each loop before its first event. Nobody is told that the application's came and went, and it takes no
/// window for its last one.
void runInApplication(QEventLoop& loop)
{
    QuitWatch const watch;
    bool const quits = QGuiApplication::quitOnLastWindowClosed();
    QGuiApplication::setQuitOnLastWindowClosed(false);
    QPointer<QCoreApplication> const application = QCoreApplication::instance();
    bool const wasSilent = application->signalsBlocked();
    QObject context;
    prepareReceiver(context);
    auto const run = [&]
    {
        QObject::disconnect(QAbstractEventDispatcher::instance(), nullptr, &context, nullptr);
        loop.exec();
        QtWayOut::take();
        application->blockSignals(true);
        QCoreApplication::exit();
    };
    QObject::connect(QAbstractEventDispatcher::instance(), &QAbstractEventDispatcher::awake, &context, run);
    QObject::connect(QAbstractEventDispatcher::instance(), &QAbstractEventDispatcher::aboutToBlock, &context, run);
    QCoreApplication::exec();
    // Asked for in the loop, its deletion may come in the end of its own.
    if (!application)
        return;
    application->blockSignals(wasSilent);
    if (quits)
        QGuiApplication::setQuitOnLastWindowClosed(true);
}

} // namespace

QtLoop::QtLoop(bool const volatile* until, bool volatile* end)
    : _until(until), _end(end), _outer(QtGuard::getInstance().getInnermostLoop())
{
    prepareReceiver(_loop);
    QAbstractEventDispatcher* const dispatcher = QAbstractEventDispatcher::instance();
    QObject::connect(dispatcher, &QAbstractEventDispatcher::awake, &_loop, [this] { endIfDone(); });
    QObject::connect(dispatcher, &QAbstractEventDispatcher::aboutToBlock, &_loop, [this] { endIfDone(); });
    QObject::connect(&_tick, &QTimer::timeout, &_loop, [this] { onTick(); });
    _tick.start(tickInterval);
    // Last: where that fails, nobody would take it back.
    QtGuard::getInstance().setInnermostLoop(this);
}

QtLoop::~QtLoop()
{
    QtGuard::getInstance().setInnermostLoop(_outer);
}

std::exception_ptr QtLoop::run()
{
    int const level = QThread::currentThread()->loopLevel();
    bool const isInOther = level > 0;
    int const loops = isInOther ? 1 : 2;
    _level = level + loops;
    auto const runLoop = [&]
    {
        if (isInOther)
            _loop.exec();
        else
            runInApplication(_loop);
    };
    std::string const reason = QtWayOut(loops).run(runLoop);
    if (!reason.empty() && !_error)
        fail(std::make_exception_ptr(ExBase(__FILE__, __LINE__, "Cannot go on: " + reason)));
    // The loop was then ended by the end of the application.
    if (!_error && !*_until && _end)
        *_end = true;
    return _error;
}

bool QtLoop::isOver() const
{
    return (*_until || !_loop.isRunning()) && QThread::currentThread()->loopLevel() <= _level;
}

void QtLoop::end()
{
    if (_end)
        *_end = true;
    else
        _loop.quit();
    endIfDone();
}

void QtLoop::endWith(QObject const& object)
{
    QObject::connect(&object, &QObject::destroyed, &_loop, [this] { end(); });
}

void QtLoop::endIfDone()
{
    if (*_until)
        _loop.quit();
}

void QtLoop::fail(std::exception_ptr const& error) noexcept
{
    QtGuard::getInstance().keep(_error, error);
    _loop.quit();
}

void QtLoop::onTick()
{
    if (QtGuard::getInstance().getInnermostLoop() != this)
        return;
    QtGuard::getInstance().checkSignals();
    endIfDone();
}

} // namespace Kv
