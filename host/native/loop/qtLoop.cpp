#include "loop/qtLoop.h"

#include <QAbstractEventDispatcher>
#include <QCoreApplication>
#include <QSignalBlocker>
#include <QThread>

#include <chrono>

namespace Kv
{

namespace
{

/// The time that Ctrl-C, and a flag that is set without an event, can stay unseen.
constexpr std::chrono::milliseconds tickInterval(50);

/// An exit that was asked for while no loop of the application itself ran is remembered for ever, and ends each later
/// loop before its first event. Only the application's own loop forgets it. Nobody is told that it came and went.
void forgetExit()
{
    QSignalBlocker const silent(QCoreApplication::instance());
    auto const exit = QObject::connect(QAbstractEventDispatcher::instance(), &QAbstractEventDispatcher::awake,
                                       QCoreApplication::instance(), [] { QCoreApplication::exit(); });
    QCoreApplication::exec();
    QObject::disconnect(exit);
}

} // namespace

QtLoop::QtLoop(bool const volatile* until, bool volatile* end)
    : _until(until), _end(end), _outer(QtGuard::getInstance().getInnermostLoop())
{
    QAbstractEventDispatcher* const dispatcher = QAbstractEventDispatcher::instance();
    QObject::connect(dispatcher, &QAbstractEventDispatcher::awake, &_loop, [this] { onTurn(); });
    QObject::connect(dispatcher, &QAbstractEventDispatcher::aboutToBlock, &_loop, [this] { onTurn(); });
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
    _loop.exec();
    if (!_turned && QThread::currentThread()->loopLevel() == 0)
    {
        forgetExit();
        _loop.exec();
    }
    // The loop was then ended by the end of the application.
    if (!_error && !*_until && _end)
        *_end = true;
    return _error;
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
    if (_error)
        QtGuard::getInstance().getScriptHook().addContext(_error, error);
    else
        _error = error;
    _loop.quit();
}

void QtLoop::onTick()
{
    if (QtGuard::getInstance().getInnermostLoop() != this)
        return;
    QtGuard::getInstance().checkSignals();
    endIfDone();
}

void QtLoop::onTurn()
{
    _turned = true;
    endIfDone();
}

} // namespace Kv
