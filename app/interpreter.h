#pragma once

#include "commandLine.h"

#include <functional>
#include <memory>
#include <string>

#include <pthread.h>

namespace Velmora
{

/// The Python interpreter of the process. Its lock is free while the application waits for the user, so that the
/// threads of scripts go on, and held while a script runs, its dialogs included.
class Interpreter
{
public:
    /// What is called with the lock held; it throws nothing.
    struct Acts
    {
        /// After all that scripts have registered for the end, with their variables in place.
        std::function<void()> atEnd;
        /// When a signal has come by which the process is to end at once, unless scripts hear of that signal
        /// themselves.
        std::function<void()> beforeKill;
    };

    /// Starts Python and loads the module `ui`. Throws `std::runtime_error`.
    explicit Interpreter(Acts acts = {});
    Interpreter(Interpreter const&) = delete;
    Interpreter& operator=(Interpreter const&) = delete;
    ~Interpreter();

    /// Runs a script as the interpreter on its own would: as `__main__`, with `sys.argv` and `sys.path` its own, and
    /// with the traceback on the standard error stream. Gives the exit status. What a script that has failed had is let
    /// go; that of one that has not stays until the next script.
    int run(ScriptCall const& call);

    /// The last line of the traceback of the script that ran last; empty if it did not fail.
    std::string const& getFailure() const { return _failure; }

    /// Runs what may run Python on its way, with the lock held. What that raises is printed. False if it was Ctrl-C.
    bool attempt(std::function<void()> const& action);

    /// Runs what is pending for the interpreter. True if that is Ctrl-C.
    bool isInterrupted();

    /// Raises a `KeyboardInterrupt` where the thread of this interpreter is, also in what blocks there. It is not lost
    /// if Python does not run then, but is met by the next who runs it. For any thread, as the next one.
    void stop() const;

    /// True if Python runs on the thread of this interpreter, or has called what runs there. Waits for the lock.
    bool isRunning() const;

    /// Ends the interpreter and all that scripts have left. Gives the exit status: `status`, or another one if the
    /// output of the scripts could not be written.
    int finish(int status);

private:
    struct Runner;

    void loadModules();

    /// Takes the error that is set, prints it, and gives the exit status that it stands for.
    int takeError();

    Acts _acts;
    std::string _failure;
    pthread_t _thread;
    std::unique_ptr<Runner> _runner;
    void* _threadState = nullptr;
};

} // namespace Velmora
