#include "loop/qtWayOut.h"

#include "loop/qtGuard.h"
#include "loop/qtReceiver.h"
#include "start/qtDisplayWatch.h"

#include <QAbstractEventDispatcher>
#include <QCoreApplication>
#include <QThread>

#include <dlfcn.h>
#include <pthread.h>
#include <utility>

namespace Kv
{

namespace
{

QtWayOut* innermost = nullptr;
std::function<void()> lastAct;
/// Qt tells each author of a handler that throws that this is not supported.
bool isLeaving = false;
/// Its application object went while a loop ran, and with it what the loop was in the middle of: no other one can
/// begin.
bool isWrecked = false;
QtMessageHandler others = nullptr;
/// That of the application object, also when that is gone.
QThread* userInterface = nullptr;

/// Where Qt's loop is one of GLib's, that keeps a list of what it was about to call, and goes on with it, as does the
/// loop around it. Preparing a turn clears it.
void forgetPendingOfGlib()
{
    void* const glib = dlopen("libglib-2.0.so.0", RTLD_NOW | RTLD_NOLOAD);
    if (!glib)
        return;
    auto* const prepare = reinterpret_cast<int (*)(void*, int*)>(dlsym(glib, "g_main_context_prepare"));
    int priority = 0;
    if (prepare)
        prepare(nullptr, &priority);
    dlclose(glib);
}

void hear(QtMsgType type, QMessageLogContext const& context, QString const& message)
{
    static thread_local bool isHearing = false;
    if (isLeaving || isHearing)
        return;
    // Behind these words Qt ends the process.
    if (message.startsWith(QLatin1String("The X11 connection broke")) ||
        message.startsWith(QLatin1String("The Wayland connection broke")) ||
        message.startsWith(QLatin1String("The Wayland connection experienced a fatal error")))
    {
        QtDisplayWatch::noteBroken();
        // A thread of Qt's that reads for the other one has no more to read. The loop sees it at its next tick.
        if (QThread::currentThread() != userInterface)
            pthread_exit(nullptr);
        QtWayOut::take();
    }
    isHearing = true;
    others(type, context, message);
    isHearing = false;
}

void listen()
{
    QtMessageHandler const other = qInstallMessageHandler(&hear);
    if (other != &hear)
        others = other;
}

void callLastAct()
{
    if (lastAct && !QtDisplayWatch::isForked())
        std::exchange(lastAct, nullptr)();
}

/// Called by the application object as it goes.
void endLoops()
{
    if (!innermost)
        return;
    callLastAct();
    QCoreApplication::exit();
}

} // namespace

QtWayOut::QtWayOut(int loops)
    : _outer(std::exchange(innermost, this)), _level(QThread::currentThread()->loopLevel() + loops),
      _depth(QtGuard::getInstance().getScriptHook().getDepth())
{
    listen();
    prepareReceiver(_context);
    // What loops are in the middle of has to outlive them, and they may call nothing more. Where they are delivering
    // posted events, the list of those forgets them next, but not how far they have come in it: a turn within theirs,
    // which reaches nobody any more, ends at the beginning.
    QObject::connect(QCoreApplication::instance(), &QObject::destroyed, &_context,
                     [dispatcher = QAbstractEventDispatcher::instance()]
                     {
                         isWrecked = true;
                         dispatcher->setParent(nullptr);
                         QCoreApplication::sendPostedEvents();
                         forgetPendingOfGlib();
                     });
}

QtWayOut::~QtWayOut()
{
    innermost = _outer;
}

void QtWayOut::watch()
{
    userInterface = QCoreApplication::instance()->thread();
    listen();
    qAddPostRoutine(&endLoops);
}

std::string QtWayOut::run(std::function<void()> const& loop)
{
    try
    {
        loop();
        return isWrecked ? findLoss() : std::string();
    }
    catch (Left const& left)
    {
        isLeaving = false;
        forgetPendingOfGlib();
        return left.reason;
    }
}

void QtWayOut::take()
{
    std::string reason = findLoss();
    if (reason.empty())
        return;
    callLastAct();
    if (!innermost || QThread::currentThread()->loopLevel() > innermost->_level ||
        QtGuard::getInstance().getScriptHook().getDepth() != innermost->_depth)
        return;
    isLeaving = true;
    throw Left{std::move(reason)};
}

std::string QtWayOut::findLoss()
{
    return isWrecked ? "the QApplication was destroyed while it ran" : QtDisplayWatch::findLoss();
}

void QtWayOut::setLastAct(std::function<void()> act)
{
    lastAct = std::move(act);
}

} // namespace Kv
