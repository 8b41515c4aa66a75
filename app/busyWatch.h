#pragma once

#include <QPoint>

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <functional>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

namespace Velmora
{

/// Sees that a script keeps the window's thread busy, so that the window answers no more, and lets the user stop it
/// all the same: in a window of another process.
class BusyWatch
{
public:
    /// The words of that window, and its place: in the middle, above the window of that number, if the platform numbers
    /// windows.
    struct Offer
    {
        std::string script;
        QPoint middle;
        quint64 window = 0;
    };

    /// Both are called on a thread of the watch: whether a script runs, and to stop it.
    BusyWatch(std::function<bool()> isBusy, std::function<void()> stop);
    BusyWatch(BusyWatch const&) = delete;
    BusyWatch& operator=(BusyWatch const&) = delete;
    ~BusyWatch();

    /// To be called when a script begins: the window for another one goes.
    void setOffer(Offer const& offer);

    /// The loop of the window's thread has come around.
    void turn();

private:
    class Connection;
    using Clock = std::chrono::steady_clock;

    void watch();
    /// True at the end of the watch.
    bool waitFor(std::chrono::milliseconds time);
    std::chrono::milliseconds getSilence() const;
    bool isWanted(int offer) const;
    /// Blocks for as long as the window is wanted.
    void offerStop();
    void start(Connection& connection);

    std::function<bool()> _isBusy;
    std::function<void()> _stop;
    std::vector<std::string> _environment;
    std::atomic<Clock::rep> _turned;
    /// The number of turns of the loop since it stood still.
    std::atomic<int> _turns{0};
    std::mutex _mutex;
    std::condition_variable _changed;
    Offer _offer;
    std::atomic<int> _offers{0};
    bool _ending = false;
    std::thread _thread;
};

} // namespace Velmora
