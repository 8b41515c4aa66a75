#pragma once

#include "ntPlatform.h"

#include <QtGlobal>

#include <exception>
#include <utility>

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

    /// Calls what has Qt call into the host in its turn: what is thrown there is thrown on from here, and no loop ends.
    template <typename Call> void carry(Call const& call)
    {
        Carrier carrier(*this);
        try
        {
            call();
        }
        catch (...)
        {
            carrier.keep(_hook->capture());
        }
        carrier.rethrow();
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

    /// Takes the exception that is being handled, for who carries it on, else for the innermost local loop.
    void take() noexcept;

    /// Makes an error the first one, or adds it to that.
    void keep(std::exception_ptr& first, std::exception_ptr const& error) const noexcept;

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

    /// One call that carries on what is thrown in it; not in a loop that began later, which ends by it. They nest.
    class Carrier
    {
    public:
        explicit Carrier(QtGuard& guard)
            : _guard(guard), _outer(std::exchange(guard._carrier, this)), _loop(guard._innermostLoop)
        {
        }
        Carrier(Carrier const&) = delete;
        Carrier& operator=(Carrier const&) = delete;
        ~Carrier() { _guard._carrier = _outer; }

        bool isIn(QtLoop const* loop) const { return loop == _loop; }
        void keep(std::exception_ptr const& error) noexcept { _guard.keep(_error, error); }
        void rethrow() const
        {
            if (_error)
                _guard._hook->rethrow(_error);
        }

    private:
        QtGuard& _guard;
        Carrier* _outer;
        QtLoop* _loop;
        std::exception_ptr _error;
    };

    bool runCall(void (*call)(void const*), void const* known);

    NtScriptHook* _hook;
    QtLoop* _innermostLoop = nullptr;
    Carrier* _carrier = nullptr;
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
