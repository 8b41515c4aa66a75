#pragma once

#include "ntPlatform.h"

#include <QtGlobal>

#include <exception>

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

    /// Calls into the host. What is thrown there stays there, and gives false; a loop that cannot go on is left from
    /// here by its `QtWayOut`. Needs no memory itself.
    template <typename Call> bool run(Call const& call)
    {
        return runCall([](void const* known) { (*static_cast<Call const*>(known))(); }, &call);
    }

    /// Runs what is the host's own, and leaves the interpreter as it is unless something is thrown.
    template <typename Call> void shield(Call const& call) noexcept
    {
        try
        {
            call();
        }
        catch (...)
        {
            take();
        }
    }

    /// Takes the exception that is being handled, for the innermost local loop.
    void take() noexcept;

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

    bool runCall(void (*call)(void const*), void const* known);

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
