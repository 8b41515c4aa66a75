#include "files/osAsync.h"

#include <algorithm>
#include <csignal>
#include <exception>
#include <list>
#include <mutex>
#include <new>
#include <pthread.h>
#include <thread>
#include <utility>
#include <vector>

namespace Kv
{

namespace
{

using Clock = std::chrono::steady_clock;

constexpr std::size_t maxThreads = 32;

struct Errand
{
    std::string path;
    std::function<void()> work;
    OsAsync::Cancelled cancelled;
    Clock::time_point begin;

    /// True if it has taken so long that the path, which is its own or below, is not to be asked for.
    bool silences(std::string const& other) const
    {
        bool const isAbove = !path.empty() && other.compare(0, path.size(), path) == 0 &&
                             (other.size() == path.size() || other[path.size()] == '/' || path.back() == '/');
        return isAbove && Clock::now() - begin > OsAsync::patience;
    }
};

using Errands = std::list<Errand>;

/// Keeps the signals of the process from threads that are started meanwhile: the interpreter waits for them in its own.
class SignalsBlocked
{
public:
    SignalsBlocked()
    {
        sigset_t all;
        sigfillset(&all);
        pthread_sigmask(SIG_SETMASK, &all, &_before);
    }
    SignalsBlocked(SignalsBlocked const&) = delete;
    SignalsBlocked& operator=(SignalsBlocked const&) = delete;
    ~SignalsBlocked() { pthread_sigmask(SIG_SETMASK, &_before, nullptr); }

private:
    sigset_t _before{};
};

/// The work that is under way, a thread each, and the work that waits for its turn.
class Desk
{
public:
    /// Never destroyed: threads that hang outlive all else.
    static Desk& getInstance()
    {
        static auto* const desk = new Desk;
        // A forked process has none of the threads, and one of them may just have had the mutex.
        static int const isTold = pthread_atfork(nullptr, nullptr, [] { ::new (desk) Desk; });
        static_cast<void>(isTold);
        return *desk;
    }

    void add(Errand errand);
    bool isSilent(std::string const& path);

private:
    /// Begins all that need not wait.
    void begin();
    void run(Errands::iterator errand);

    // The mutex is held for these.
    std::vector<Errands::iterator> takeReady();
    bool hasToWait(Errand const& errand) const;

    std::mutex _mutex;
    Errands _waiting;
    Errands _underWay;
};

void Desk::add(Errand errand)
{
    {
        std::lock_guard<std::mutex> const lock(_mutex);
        _waiting.push_back(std::move(errand));
    }
    begin();
}

bool Desk::isSilent(std::string const& path)
{
    std::lock_guard<std::mutex> const lock(_mutex);
    return std::any_of(_underWay.begin(), _underWay.end(), [&path](Errand const& one) { return one.silences(path); });
}

void Desk::begin()
{
    std::unique_lock<std::mutex> lock(_mutex);
    std::vector<Errands::iterator> const ready = takeReady();
    lock.unlock();
    for (auto const errand : ready)
        try
        {
            SignalsBlocked const blocked;
            std::thread(
                [this, errand]
                {
                    try
                    {
                        run(errand);
                    }
                    catch (...) // NOLINT(bugprone-empty-catch)
                    {
                        // Without the memory to tell of it, there is nothing left but not to end the process.
                    }
                })
                .detach();
        }
        catch (std::exception const&)
        {
            // No thread is to be had: it takes as long as it takes.
            run(errand);
        }
}

void Desk::run(Errands::iterator errand)
{
    if (!*errand->cancelled)
        errand->work();
    // What it owns goes before others wait for the mutex.
    errand->work = nullptr;
    {
        std::lock_guard<std::mutex> const lock(_mutex);
        _underWay.erase(errand);
    }
    begin();
}

std::vector<Errands::iterator> Desk::takeReady()
{
    std::vector<Errands::iterator> ready;
    // Nothing that is taken is lost for lack of memory.
    ready.reserve(_waiting.size());
    _waiting.remove_if([](Errand const& errand) { return errand.cancelled->load(); });
    for (auto next = _waiting.begin(); next != _waiting.end() && _underWay.size() < maxThreads;)
    {
        auto const errand = next++;
        if (hasToWait(*errand))
            continue;
        _underWay.splice(_underWay.end(), _waiting, errand);
        errand->begin = Clock::now();
        ready.push_back(errand);
    }
    return ready;
}

bool Desk::hasToWait(Errand const& errand) const
{
    return std::any_of(_underWay.begin(), _underWay.end(),
                       [&errand](Errand const& one) { return one.path == errand.path || one.silences(errand.path); });
}

} // namespace

void OsAsync::start(std::string const& path, std::function<void()> work, Cancelled const& cancelled)
{
    Desk::getInstance().add({path, std::move(work), cancelled, {}});
}

bool OsAsync::isSilent(std::string const& path)
{
    return Desk::getInstance().isSilent(path);
}

} // namespace Kv
