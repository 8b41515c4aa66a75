#include "loop/qtGuard.h"

#include "loop/qtLoop.h"
#include "windows/qtStage.h"

#include <QCoreApplication>
#include <QThread>

#include <cstdio>
#include <memory>
#include <utility>

namespace Kv
{

namespace
{

/// Holds the interpreter, also where the hook is taken away meanwhile.
class InterpreterHold
{
public:
    explicit InterpreterHold(NtScriptHook* hook) : _hook(hook)
    {
        if (_hook)
            _hook->enter();
    }
    InterpreterHold(InterpreterHold const&) = delete;
    InterpreterHold& operator=(InterpreterHold const&) = delete;
    ~InterpreterHold()
    {
        if (_hook)
            _hook->leave();
    }

private:
    NtScriptHook* _hook;
};

void print(std::exception_ptr const& error) noexcept
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

} // namespace

QtErrorAside::QtErrorAside() : _error(QtGuard::getInstance().takeError()) {}

QtErrorAside::~QtErrorAside()
{
    if (_error)
        QtGuard::getInstance().putErrorBack(_error);
}

QtGuard& QtGuard::getInstance()
{
    // Never destroyed: peers go as late as the last objects of the interpreter do.
    static auto* const guard = new QtGuard;
    return *guard;
}

void QtGuard::run(std::function<void()> const& call) noexcept
{
    {
        InterpreterHold const hold(_hook);
        ++_depth;
        quint64 const outerCall = std::exchange(_currentCall, ++_calls);
        try
        {
            call();
        }
        catch (...)
        {
            take();
        }
        _currentCall = outerCall;
        --_depth;
    }
    if (_innermostLoop)
        _innermostLoop->endIfDone();
}

void QtGuard::checkSignals() noexcept
{
    if (_hook)
        run([hook = _hook] { hook->checkSignals(); });
}

void QtGuard::interrupt() const noexcept
{
    if (_hook)
        _hook->interrupt();
}

void QtGuard::rethrow(std::exception_ptr const& error) const
{
    if (_hook)
        _hook->rethrow(error);
    std::rethrow_exception(error);
}

std::exception_ptr QtGuard::takeError() const noexcept
{
    return _hook ? _hook->takeError() : nullptr;
}

void QtGuard::putErrorBack(std::exception_ptr const& error) const noexcept
{
    if (_hook)
        _hook->putErrorBack(error);
}

void QtGuard::addContext(std::exception_ptr const& first, std::exception_ptr const& later) const noexcept
{
    if (_hook)
        _hook->addContext(first, later);
    else
        print(later);
}

QtGuard::Moment QtGuard::getMoment() const
{
    return {_currentCall, QThread::currentThread()->loopLevel()};
}

void QtGuard::destroy(QWidget* widget)
{
    QtErrorAside const aside;
    // Without its application a widget can no longer be touched.
    if (!widget || !QCoreApplication::instance())
        return;
    if (widget->thread() != QThread::currentThread())
    {
        widget->deleteLater();
        return;
    }
    if (getMoment() == QtStage::findBirth(*widget))
    {
        std::unique_ptr<QWidget> const done(widget);
        return;
    }
    widget->hide();
    widget->deleteLater();
    _waiting.emplace_back(widget);
}

void QtGuard::destroyWaiting()
{
    if (_depth > 0 || _innermostLoop || !QCoreApplication::instance())
        return;
    for (QPointer<QWidget> const& widget : std::exchange(_waiting, {}))
        if (widget)
            QCoreApplication::sendPostedEvents(widget, QEvent::DeferredDelete);
}

void QtGuard::take() noexcept
{
    std::exception_ptr const error = capture();
    if (_innermostLoop)
        _innermostLoop->fail(error);
    else
        report(error);
}

std::exception_ptr QtGuard::capture() const noexcept
{
    return _hook ? _hook->capture() : std::current_exception();
}

void QtGuard::report(std::exception_ptr const& error) const noexcept
{
    if (_hook)
        _hook->report(error);
    else
        print(error);
}

} // namespace Kv
