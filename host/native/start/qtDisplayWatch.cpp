#include "start/qtDisplayWatch.h"

#include <QGuiApplication>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <poll.h>
#include <pthread.h>
#include <string>
#include <thread>
#include <unistd.h>
#include <xcb/xcb.h>

namespace Kv
{

namespace
{

/// The application object that is watched; only compared.
void const* watched = nullptr;
/// True where its windows are another process's matter.
bool isOutside = false;
/// Threads of Qt's note it too.
std::atomic<bool> isBroken = false;
/// In a process that has been forked from the one that the connection belongs to.
bool isInFork = false;
/// That of Qt's connection to the X server; negative on another platform.
int connection = -1;

bool drawsOutsideTheProcess()
{
    QString const name = QGuiApplication::platformName();
    return name == QLatin1String("xcb") || name.startsWith(QLatin1String("wayland"));
}

/// A thread of Qt's that reads for a Wayland display has been woken, and not slept since.
bool isReaderAwake()
{
    std::error_code error;
    std::filesystem::directory_iterator const threads("/proc/self/task", error);
    return std::any_of(begin(threads), end(threads),
                       [](std::filesystem::directory_entry const& thread)
                       {
                           std::string identity;
                           std::string name;
                           char state = 0;
                           std::ifstream(thread.path() / "stat") >> identity >> name >> state;
                           return name == "(WaylandEventThr)" && state != 'S';
                       });
}

/// Qt ends the threads that read for a Wayland display with its application object. One that was woken to read, and is
/// told to end before it does, never says that it will not: the next one to end waits for it for ever.
void letReadersRest()
{
    auto const patience = std::chrono::steady_clock::now() + std::chrono::seconds(1);
    while (isReaderAwake() && std::chrono::steady_clock::now() < patience)
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
}

/// Static objects of Qt's wait at the exit for threads that a forked process does not have.
void exitWithoutQt(int status, void*)
{
    (void)std::fflush(nullptr);
    _exit(status);
}

/// Runs in the forked process. What it said to the X server would come in the middle of what its parent says: whoever
/// tries finds the connection broken instead.
void leaveDisplayToParent()
{
    if (!watched)
        return;
    on_exit(&exitWithoutQt, nullptr);
    if (!isOutside)
        return;
    isInFork = true;
    if (connection < 0)
        return;
    int const nobody = open("/dev/null", O_RDONLY | O_CLOEXEC);
    dup2(nobody, connection);
    close(nobody);
}

} // namespace

bool QtDisplayWatch::watch()
{
    auto* const application = qobject_cast<QGuiApplication*>(QCoreApplication::instance());
    if (!application || watched == application || isInFork)
        return false;
    static int const isTold = pthread_atfork(nullptr, nullptr, &leaveDisplayToParent);
    static_cast<void>(isTold);
    watched = application;
    isBroken = false;
    isOutside = drawsOutsideTheProcess();
    auto* const x11 = application->nativeInterface<QNativeInterface::QX11Application>();
    connection = x11 && x11->connection() ? xcb_get_file_descriptor(x11->connection()) : -1;
    QObject::connect(application, &QObject::destroyed,
                     []
                     {
                         letReadersRest();
                         watched = nullptr;
                         isOutside = false;
                         connection = -1;
                     });
    return true;
}

bool QtDisplayWatch::isForked()
{
    return isInFork;
}

std::string QtDisplayWatch::findLoss()
{
    if (isInFork)
        return "this process was forked from the one that the windows belong to; start it as a program of its own "
               "(for multiprocessing: the start method \"spawn\")";
    pollfd state{connection, POLLRDHUP, 0};
    if (poll(&state, 1, 0) > 0)
        isBroken = true;
    return isBroken ? "the display is gone: the connection to it is broken" : "";
}

void QtDisplayWatch::noteBroken()
{
    isBroken = true;
}

} // namespace Kv
