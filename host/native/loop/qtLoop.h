#pragma once

#include "loop/qtGuard.h"

#include <QEventLoop>
#include <QTimer>

#include <exception>

namespace Kv
{

/// One run of the local message loop, on the stack of the one who runs it. The guard knows the innermost; loops begin
/// and end like brackets.
class QtLoop
{
public:
    /// Both flags are borrowed; `end` can be null.
    QtLoop(bool const volatile* until, bool volatile* end);
    QtLoop(QtLoop const&) = delete;
    QtLoop& operator=(QtLoop const&) = delete;
    ~QtLoop();

    /// Dispatches events until the flag is true or an error came; gives that error, or null.
    std::exception_ptr run();

    /// True once it has been ended, but not in loops that run in it.
    bool isOver() const;

    /// The loop that this one runs in; null for the outermost.
    QtLoop* getOuter() const { return _outer; }

    /// Sets the end flag, which ends the loop.
    void end();

    /// Ends the loop when the object is destroyed, by whomever.
    void endWith(QObject const& object);

    /// Ends the loop if its flag says so.
    void endIfDone();

    /// Ends the loop with an error.
    void fail(std::exception_ptr const& error) noexcept;

private:
    void onTick();

    bool const volatile* _until;
    bool volatile* _end;
    QtLoop* _outer;
    /// The number of Qt's loops that turn in each other while it does.
    int _level = 0;
    std::exception_ptr _error;
    QEventLoop _loop;
    QTimer _tick;
};

} // namespace Kv
