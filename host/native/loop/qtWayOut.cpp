#include "loop/qtWayOut.h"

#include "loop/qtGuard.h"
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

/// Where Qt's loop is one of GLib's, that keeps a list of what it was about to call. The loop around it would go on
/// with that list; preparing a turn clears it.
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

bool isOnUserInterface()
{
    return QCoreApplication::instance() && QThread::currentThread() == QCoreApplication::instance()->thread();
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
        if (!isOnUserInterface())
            pthread_exit(nullptr);
        QtWayOut::take();
    }
    isHearing = true;
    others(type, context, message);
    isHearing = false;
}

} // namespace

QtWayOut::QtWayOut(int loops)
    : _outer(std::exchange(innermost, this)), _level(QThread::currentThread()->loopLevel() + loops),
      _depth(QtGuard::getInstance().getScriptHook().getDepth())
{
    listen();
    // What loops are in the middle of has to outlive them.
    QObject::connect(QCoreApplication::instance(), &QObject::destroyed, &_context,
                     [dispatcher = QAbstractEventDispatcher::instance()]
                     {
                         isWrecked = true;
                         dispatcher->setParent(nullptr);
                     });
}

QtWayOut::~QtWayOut()
{
    innermost = _outer;
}

void QtWayOut::listen()
{
    QtMessageHandler const other = qInstallMessageHandler(&hear);
    if (other != &hear)
        others = other;
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
    if (lastAct && !QtDisplayWatch::isForked())
        std::exchange(lastAct, nullptr)();
    if (!innermost || QThread::currentThread()->loopLevel() > innermost->_level ||
        QtGuard::getInstance().getScriptHook().getDepth() != innermost->_depth)
        return;
    isLeaving = true;
    throw Left{std::move(reason)};
}

std::string QtWayOut::findLoss()
{
    return isWrecked ? "the QApplication was destroyed while a dialog ran" : QtDisplayWatch::findLoss();
}

void QtWayOut::setLastAct(std::function<void()> act)
{
    lastAct = std::move(act);
}

} // namespace Kv
