#include "busyWatch.h"

#include "stopWindow.h"

#include <QGuiApplication>

#include <algorithm>
#include <array>
#include <csignal>
#include <fcntl.h>
#include <poll.h>
#include <string_view>
#include <sys/socket.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <unistd.h>
#include <utility>

namespace Velmora
{

namespace
{

using std::chrono::milliseconds;

/// The time that the loop may stand still before the user is offered to stop what runs.
constexpr milliseconds patience(2000);

/// The time for which a user who has declined is left alone.
constexpr milliseconds respite(30000);

constexpr milliseconds glance(50);

/// A loop that stood still for longer does not come around as it should.
constexpr milliseconds longestTurn(1000);

/// The number of turns of the loop after which the window answers again.
constexpr int calmTurns = 8;

/// As the system takes them; null comes last.
std::vector<char*> getPointers(std::vector<std::string>& words)
{
    std::vector<char*> pointers;
    pointers.reserve(words.size() + 1);
    for (std::string& word : words)
        pointers.push_back(word.data());
    pointers.push_back(nullptr);
    return pointers;
}

/// This program, with another command line.
[[noreturn]] void become(std::vector<char*> const& command, std::vector<char*> const& environment, int input)
{
    // Ctrl-C in the terminal is for the application.
    setsid();
    int const nowhere = open("/dev/null", O_RDWR);
    dup2(input, STDIN_FILENO);
    dup2(nowhere, STDOUT_FILENO);
    dup2(nowhere, STDERR_FILENO);
    sigset_t none;
    sigemptyset(&none);
    sigprocmask(SIG_SETMASK, &none, nullptr);
    execve("/proc/self/exe", command.data(), environment.data());
    _exit(1);
}

/// As it is before scripts change it, with the platform that is in use.
std::vector<std::string> makeEnvironment()
{
    std::string const platform = "QT_QPA_PLATFORM=";
    std::vector<std::string> variables;
    for (char** variable = environ; *variable; ++variable)
        if (std::string_view(*variable).substr(0, platform.size()) != platform)
            variables.emplace_back(*variable);
    variables.push_back(platform + QGuiApplication::platformName().toStdString());
    return variables;
}

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
    : _isBusy(std::move(isBusy)), _stop(std::move(stop)), _environment(makeEnvironment()),
      _turned(Clock::now().time_since_epoch().count())
{
    sigset_t const former = blockSignals();
    _thread = std::thread([this] { watch(); });
    pthread_sigmask(SIG_SETMASK, &former, nullptr);
}

BusyWatch::~BusyWatch()
{
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
    ++_offers;
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

bool BusyWatch::isWanted(int offer) const
{
    return _offers == offer && (getSilence() > longestTurn || (_turns < calmTurns && _isBusy()));
}

void BusyWatch::offerStop()
{
    int const offer = _offers;
    Connection connection;
    // For want of file handles: another time.
    if (connection.getOwn() < 0)
        return;
    start(connection);
    pollfd answer{connection.getOwn(), POLLIN, 0};
    while (!waitFor(milliseconds(0)) && isWanted(offer))
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
        while (Clock::now() < end && isWanted(offer) && !waitFor(glance))
        {
        }
        return;
    }
}

void BusyWatch::start(Connection& connection)
{
    std::vector<std::string> words;
    {
        std::lock_guard<std::mutex> const lock(_mutex);
        words = StopWindow::makeCommand(_offer);
    }
    std::vector<char*> const command = getPointers(words);
    std::vector<char*> const environment = getPointers(_environment);
    // Neither the process between nor that of the window can be met by a script that waits for any child of its own:
    // the one ends without a signal, the other is no child. Between here and the program only what is safe in a copy of
    // a process with several threads is called.
    auto const between = static_cast<pid_t>(syscall(SYS_clone, 0, nullptr, nullptr, nullptr, nullptr));
    if (between == 0)
    {
        if (_Fork() == 0)
            become(command, environment, connection.getOther());
        _exit(0);
    }
    if (between > 0)
        waitpid(between, nullptr, __WCLONE);
    connection.closeOther();
}

} // namespace Velmora
