#pragma once

#include "ntPlatform.h"

#include <QPointer>
#include <QWidget>

#include <exception>
#include <functional>
#include <vector>

namespace Kv
{

class QtLoop;

/// Keeps the interpreter's error, which is on its way out, off the interpreter for as long as this lives. To be held
/// where windows go or come back: Qt tells others of it, and those may run Python code.
class QtErrorAside
{
public:
    QtErrorAside();
    QtErrorAside(QtErrorAside const&) = delete;
    QtErrorAside& operator=(QtErrorAside const&) = delete;
    ~QtErrorAside();

private:
    std::exception_ptr _error;
};

/// The one place where the toolkit calls into the host. Takes the interpreter for the call, and keeps what a handler
/// throws from the toolkit's frames: the innermost local loop ends and carries it out. Owns nothing but the
/// widgets that cannot go yet since the toolkit may be in the middle of one of their events.
class QtGuard
{
public:
    static QtGuard& getInstance();

    /// Borrowed; null takes the hook away.
    void setScriptHook(NtScriptHook* hook) { _hook = hook; }

    /// Calls into the host; nothing that is thrown comes out.
    void run(std::function<void()> const& call) noexcept;

    /// Runs what is pending for the interpreter, guarded.
    void checkSignals() noexcept;

    /// Interrupts the script that runs, as Ctrl-C would.
    void interrupt() const noexcept;

    /// Throws on what a loop has carried out.
    [[noreturn]] void rethrow(std::exception_ptr const& error) const;

    /// Takes the interpreter's error off it, and puts it back. Null where there is none.
    std::exception_ptr takeError() const noexcept;
    void putErrorBack(std::exception_ptr const& error) const noexcept;

    /// `later` came while `first` was on its way out.
    void addContext(std::exception_ptr const& first, std::exception_ptr const& later) const noexcept;

    QtLoop* getInnermostLoop() const { return _innermostLoop; }
    void setInnermostLoop(QtLoop* loop) { _innermostLoop = loop; }

    /// The call from the toolkit and the loop that are under way. What was made and goes at the same moment of these
    /// cannot be in the middle of one of its events.
    struct Moment
    {
        quint64 call = 0;
        int loopLevel = 0;

        friend bool operator==(Moment const& a, Moment const& b)
        {
            return a.call == b.call && a.loopLevel == b.loopLevel;
        }
    };

    Moment getMoment() const;

    /// Destroys a widget that its owner has done with, as soon as that can be: at once, or when the call from the
    /// toolkit that is under way has returned, or on the widget's own thread.
    void destroy(QWidget* widget);

    /// Destroys the widgets that had to wait, where no call from the toolkit is under way any more.
    void destroyWaiting();

private:
    void take() noexcept;
    std::exception_ptr capture() const noexcept;
    void report(std::exception_ptr const& error) const noexcept;

    NtScriptHook* _hook = nullptr;
    QtLoop* _innermostLoop = nullptr;
    int _depth = 0;
    quint64 _calls = 0;
    quint64 _currentCall = 0;
    std::vector<QPointer<QWidget>> _waiting;
};

} // namespace Kv
