#pragma once

#include <QObject>

#include <functional>
#include <string>

namespace Kv
{

/// A way out of a loop of Qt's, for where Qt would go on with what is not there any more: it ends the process when the
/// display is gone, and crashes when its application object is. Its frames are left by an exception then, without a
/// look back; none of them can do anything sensible any more.
class QtWayOut
{
public:
    /// What Qt's frames are left by.
    struct Left
    {
        std::string reason;
    };

    /// `loops` is the number of loops that are going to run in one another, before the one to be left.
    explicit QtWayOut(int loops = 1);
    QtWayOut(QtWayOut const&) = delete;
    QtWayOut& operator=(QtWayOut const&) = delete;
    ~QtWayOut();

    /// Runs a function that runs a loop of Qt's. Gives the words for why the loop had to be left; empty where it ended.
    std::string run(std::function<void()> const& loop);

    /// For each new application object. Hears what Qt says before it ends the process, and ends the loops when that
    /// object goes: they would turn for ever without it.
    static void watch();

    /// The words for why no loop can run; empty where one can.
    static std::string findLoss();

    /// Called with nothing of Qt's on the stack but what may be left. Leaves the innermost loop if it has to be, and if
    /// it is one that there is a way out of.
    static void take();

    /// Called once when the display is gone, before Qt may end the process. Throws nothing.
    static void setLastAct(std::function<void()> act);

private:
    QtWayOut* _outer;
    /// The number of Qt's loops on the thread, with those that are run.
    int _level;
    /// How deep the stack is in the interpreter. Its frames must not be left so.
    int _depth;
    QObject _context;
};

} // namespace Kv
