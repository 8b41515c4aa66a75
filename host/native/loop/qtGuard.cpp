#include "loop/qtGuard.h"

#include "loop/qtLoop.h"
#include "loop/qtSpareHandles.h"
#include "loop/qtWayOut.h"

#include <QThread>

#include <cstdio>
#include <utility>

namespace Kv
{

namespace
{

/// Stands in where no interpreter is: passes exceptions on as they are, and prints those that nobody takes.
class NoScriptHook : public NtScriptHook
{
public:
    int enter() noexcept override
    {
        ++_depth;
        return 0;
    }
    void leave(int) noexcept override { --_depth; }
    int getDepth() noexcept override { return _depth; }
    std::exception_ptr capture() noexcept override { return std::current_exception(); }
    [[noreturn]] void rethrow(std::exception_ptr const& error) override { std::rethrow_exception(error); }
    std::exception_ptr takeError() noexcept override { return nullptr; }
    void putErrorBack(std::exception_ptr const&) noexcept override {}
    void addContext(std::exception_ptr const&, std::exception_ptr const& later) noexcept override { report(later); }
    void checkSignals() override {}
    void interrupt() noexcept override {}
    void callAtThreadEnd(void (*)()) noexcept override {}

    void report(std::exception_ptr const& error) noexcept override
    {
        try
        {
            std::rethrow_exception(error);
        }
        catch (std::exception const& exception)
        {
            (void)std::fprintf(stderr, "%s\n", exception.what());
        }
        catch (...)
        {
            (void)std::fputs("A handler threw what is no exception\n", stderr);
        }
    }

private:
    int _depth = 0;
};

NtScriptHook* getNoScriptHook()
{
    static auto* const hook = new NoScriptHook;
    return hook;
}

/// Holds the interpreter, also where the hook is taken away meanwhile.
class InterpreterHold
{
public:
    explicit InterpreterHold(NtScriptHook& hook) : _hook(hook), _before(_hook.enter()) {}
    InterpreterHold(InterpreterHold const&) = delete;
    InterpreterHold& operator=(InterpreterHold const&) = delete;
    ~InterpreterHold() { _hook.leave(_before); }

private:
    NtScriptHook& _hook;
    int _before;
};

} // namespace

QtGuard& QtGuard::getInstance()
{
    // Never destroyed: peers go as late as the last objects of the interpreter do.
    static auto* const guard = new QtGuard;
    return *guard;
}

QtGuard::QtGuard() : _hook(getNoScriptHook()) {}

void QtGuard::setScriptHook(NtScriptHook* hook)
{
    _hook = hook ? hook : getNoScriptHook();
}

bool QtGuard::runCall(void (*call)(void const*), void const* known)
{
    bool isDone = false;
    {
        InterpreterHold const hold(*_hook);
        QtSpareHandles::Pause const pause;
        ++_depth;
        quint64 const outerCall = std::exchange(_currentCall, ++_calls);
        try
        {
            call(known);
            isDone = true;
        }
        catch (...)
        {
            take();
        }
        _currentCall = outerCall;
        --_depth;
    }
    if (_innermostLoop)
    {
        _innermostLoop->endIfDone();
        QtWayOut::take();
    }
    return isDone;
}

void QtGuard::keep(std::exception_ptr& first, std::exception_ptr const& error) const noexcept
{
    if (first)
        _hook->addContext(first, error);
    else
        first = error;
}

void QtGuard::checkSignals()
{
    run([hook = _hook] { hook->checkSignals(); });
}

void QtGuard::endLoops() const
{
    for (QtLoop* loop = _innermostLoop; loop; loop = loop->getOuter())
        loop->end();
}

QtMoment QtGuard::getMoment() const
{
    return {_currentCall, QThread::currentThread()->loopLevel()};
}

void QtGuard::take() noexcept
{
    InterpreterHold const hold(*_hook);
    std::exception_ptr const error = _hook->capture();
    if (_carrier && _carrier->isIn(_innermostLoop))
        _carrier->keep(error);
    else if (_innermostLoop)
        _innermostLoop->fail(error);
    else
        _hook->report(error);
}

} // namespace Kv
