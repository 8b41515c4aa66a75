#pragma once

#include "ntPlatform.h"

#include <QtGlobal>

#include <exception>
#include <functional>

namespace Kv
{

class QtLoop;

/// A moment of the user interface's thread: the call from Qt that was under way, and how many loops were.
struct QtMoment
{
    quint64 call = 0;
    int loopLevel = 0;

    friend bool operator==(QtMoment const& a, QtMoment const& b)
    {
        return a.call == b.call && a.loopLevel == b.loopLevel;
    }
};

/// The one place where Qt calls into the host. Takes the interpreter for the call, and keeps what a handler throws from
/// Qt's frames: the innermost local loop ends and carries it out.
class QtGuard
{
public:
    static QtGuard& getInstance();

    /// Borrowed; null takes the hook away.
    void setScriptHook(NtScriptHook* hook);

    /// Without an interpreter a hook that does as much as it can.
    NtScriptHook& getScriptHook() const { return *_hook; }

    /// Calls into the host. What is thrown there stays there; a loop that cannot go on is left from here by its
    /// `QtWayOut`.
    void run(std::function<void()> const& call);

    /// Runs what is pending for the interpreter, guarded.
    void checkSignals();

    QtLoop* getInnermostLoop() const { return _innermostLoop; }
    void setInnermostLoop(QtLoop* loop) { _innermostLoop = loop; }

    /// Ends all loops, each by its end flag.
    void endLoops() const;

    QtMoment getMoment() const;

    /// True where neither a call from Qt nor a local loop is under way.
    bool isIdle() const { return _depth == 0 && !_innermostLoop; }

private:
    QtGuard();

    /// Takes the exception that is being handled.
    void take() noexcept;

    NtScriptHook* _hook;
    QtLoop* _innermostLoop = nullptr;
    int _depth = 0;
    quint64 _calls = 0;
    quint64 _currentCall = 0;
};

/// Keeps the interpreter's error, which is on its way out, off the interpreter for as long as this lives. Held where
/// windows go or come back: Qt tells others of it, and those may run Python code.
class QtErrorAside
{
public:
    QtErrorAside() : _error(QtGuard::getInstance().getScriptHook().takeError()) {}
    QtErrorAside(QtErrorAside const&) = delete;
    QtErrorAside& operator=(QtErrorAside const&) = delete;
    ~QtErrorAside()
    {
        if (_error)
            QtGuard::getInstance().getScriptHook().putErrorBack(_error);
    }

private:
    std::exception_ptr _error;
};

} // namespace Kv
