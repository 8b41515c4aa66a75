#include "busyWatch.h"

#include "stopWindow.h"

#include <QGuiApplication>
#include <QProcess>

#include <algorithm>
#include <array>
#include <csignal>
#include <fcntl.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>
#include <utility>

namespace Velmora
{

namespace
{

using std::chrono::milliseconds;

/// How long the loop may stand still before the user is offered to stop what runs.
constexpr milliseconds patience(2000);

/// How long the user who has declined is left alone.
constexpr milliseconds respite(30000);

constexpr milliseconds glance(50);

/// A loop that stood still for longer does not come around as it should.
constexpr milliseconds longestTurn(1000);

/// How often the loop has to come around for the window to answer again.
constexpr int calmTurns = 8;

/// Signals of the process are for the window's thread, where they interrupt what blocks.
sigset_t blockSignals()
{
    sigset_t all;
    sigset_t former;
    sigfillset(&all);
    pthread_sigmask(SIG_SETMASK, &all, &former);
    return former;
}

} // namespace

/// A connection to another process, with both of its ends.
class BusyWatch::Connection
{
public:
    Connection()
    {
        if (socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, _ends.data()) != 0)
            _ends = {-1, -1};
    }
    Connection(Connection const&) = delete;
    Connection& operator=(Connection const&) = delete;
    ~Connection()
    {
        // Also for a copy that a child of a script has.
        shutdown(_ends[0], SHUT_RDWR);
        close(_ends[0]);
        closeOther();
    }

    int getOwn() const { return _ends[0]; }
    int getOther() const { return _ends[1]; }
    void closeOther() { close(std::exchange(_ends[1], -1)); }

private:
    std::array<int, 2> _ends{};
};

BusyWatch::BusyWatch(std::function<bool()> isBusy, std::function<void()> stop)
    : _isBusy(std::move(isBusy)), _stop(std::move(stop)), _environment(QProcessEnvironment::systemEnvironment()),
      _turned(Clock::now().time_since_epoch().count()), _process(getpid())
{
    _environment.insert(QStringLiteral("QT_QPA_PLATFORM"), QGuiApplication::platformName());
    sigset_t const former = blockSignals();
    _thread = std::thread([this] { watch(); });
    pthread_sigmask(SIG_SETMASK, &former, nullptr);
}

BusyWatch::~BusyWatch()
{
    if (_process != getpid())
    {
        // The child of a script has no such thread.
        _thread.detach();
        return;
    }
    {
        std::lock_guard<std::mutex> const lock(_mutex);
        _ending = true;
    }
    _changed.notify_all();
    _thread.join();
}

void BusyWatch::setOffer(Offer const& offer)
{
    std::lock_guard<std::mutex> const lock(_mutex);
    _offer = offer;
}

void BusyWatch::turn()
{
    _turns = getSilence() > longestTurn ? 0 : _turns + 1;
    _turned = Clock::now().time_since_epoch().count();
}

void BusyWatch::watch()
{
    while (!waitFor(std::max(patience - getSilence(), glance)))
        if (getSilence() > patience && _isBusy())
            offerStop();
}

bool BusyWatch::waitFor(milliseconds time)
{
    std::unique_lock<std::mutex> lock(_mutex);
    return _changed.wait_for(lock, time, [this] { return _ending; });
}

milliseconds BusyWatch::getSilence() const
{
    Clock::time_point const turned{Clock::duration(_turned)};
    return std::chrono::duration_cast<milliseconds>(Clock::now() - turned);
}

bool BusyWatch::isWanted() const
{
    return getSilence() > longestTurn || (_turns < calmTurns && _isBusy());
}

void BusyWatch::offerStop()
{
    Connection connection;
    start(connection);
    pollfd answer{connection.getOwn(), POLLIN, 0};
    while (!waitFor(milliseconds(0)) && isWanted())
    {
        char said = 0;
        if (poll(&answer, 1, static_cast<int>(glance.count())) <= 0)
            continue;
        if (read(connection.getOwn(), &said, 1) == 1)
        {
            _stop();
            continue;
        }
        auto const end = Clock::now() + respite;
        while (Clock::now() < end && isWanted() && !waitFor(glance))
        {
        }
        return;
    }
}

void BusyWatch::start(Connection& connection)
{
    QProcess window;
    window.setProgram(QStringLiteral("/proc/self/exe"));
    {
        std::lock_guard<std::mutex> const lock(_mutex);
        window.setArguments(StopWindow::makeArguments(_offer));
    }
    window.setProcessEnvironment(_environment);
    window.setStandardOutputFile(QProcess::nullDevice());
    window.setStandardErrorFile(QProcess::nullDevice());
    window.setChildProcessModifier(
        [end = connection.getOther()]
        {
            dup2(end, STDIN_FILENO);
            sigset_t none;
            sigemptyset(&none);
            pthread_sigmask(SIG_SETMASK, &none, nullptr);
        });
    // No child of this process, which a script may wait for.
    window.startDetached();
    connection.closeOther();
}

} // namespace Velmora
