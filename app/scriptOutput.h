#pragma once

#include <chrono>
#include <deque>
#include <functional>
#include <mutex>
#include <string>
#include <string_view>
#include <utility>

namespace Velmora
{

/// A line of the log.
struct LogLine
{
    enum class Kind
    {
        Output,
        Error,
        /// Not printed by a script, but said of one.
        Note,
    };

    Kind kind = Kind::Output;
    std::chrono::system_clock::time_point time;
    /// UTF-8, without the end of the line.
    std::string text;
    /// True if more can come.
    bool isOpen = false;
};

/// The number of lines that the log holds.
constexpr int logLength = 10000;

/// The output of scripts, cut into lines for the log. No more than the log holds wait there to be taken; the oldest go
/// first. All of it but the listener is for any thread.
class ScriptOutput
{
public:
    /// Is called on the thread that prints, if nothing waited there, and if something has waited for a while.
    void setListener(std::function<void()> onArrival) { _onArrival = std::move(onArrival); }

    /// Makes Python's standard streams leave a copy here of all that goes through them; to be called with the
    /// interpreter's lock. They remain what scripts expect, and write to the same files in the same order. This has to
    /// outlive the interpreter. Throws `boost::python::error_already_set`.
    void tapStreams();

    /// Adds bytes of UTF-8, which may begin and end anywhere.
    void add(LogLine::Kind kind, std::string_view bytes);

    /// The lines that have not been taken. The last one is given again, with what has come since, if it was open.
    std::deque<LogLine> take();

private:
    void append(LogLine::Kind kind, std::string_view bytes);
    void appendPart(LogLine::Kind kind, std::string_view part);
    LogLine& findOpenLine(LogLine::Kind kind);

    std::function<void()> _onArrival;
    std::mutex _mutex;
    std::deque<LogLine> _lines;
    std::chrono::steady_clock::time_point _told;
    bool _waiting = false;
    /// After a carriage return, what comes next takes the place of the open line's text.
    bool _startsAnew = false;
};

} // namespace Velmora
