#include <boost/python.hpp>

#include "interpreter.h"

#include "pythonError.h"
#include "pythonLock.h"

#include <csignal>
#include <filesystem>
#include <unistd.h>
#include <utility>

namespace bp = boost::python;

namespace Velmora
{

namespace
{

/// The source of `scriptRunner.py`.
constexpr char const* runnerSource =
#include "scriptRunner.inc"
    ;

bp::object toBytes(std::string const& bytes)
{
    return bp::object(bp::handle<>(PyBytes_FromStringAndSize(bytes.data(), static_cast<Py_ssize_t>(bytes.size()))));
}

/// The modules lie in the same tree as this program.
std::filesystem::path getModuleFolder()
{
    return std::filesystem::canonical("/proc/self/exe").parent_path().parent_path() / KV_PACKAGE_PLACE;
}

void require(PyStatus const& status)
{
    if (PyStatus_Exception(status))
        throw std::runtime_error(std::string("Python cannot be started: ") +
                                 (status.err_msg ? status.err_msg : "it ends at once"));
}

void start()
{
    PyConfig config;
    PyConfig_InitPythonConfig(&config);
    std::unique_ptr<PyConfig, decltype(&PyConfig_Clear)> const clearing(&config, &PyConfig_Clear);
    config.parse_argv = 0;
    // Scripts start other scripts by it.
    require(PyConfig_SetBytesString(&config, &config.executable, KV_PYTHON));
    require(PyConfig_SetBytesString(&config, &config.program_name, KV_PYTHON));
    require(Py_InitializeFromConfig(&config));
}

/// The signal that stops a script. Ctrl-C's own is ignored in a process that a shell has started in the background, and
/// a script may do with it what it likes.
int getStopSignal()
{
    return SIGRTMAX - 1;
}

/// Borrowed from the one interpreter.
Interpreter::Acts const* acts = nullptr;

void runLastAct()
{
    if (acts->atEnd)
        acts->atEnd();
}

pid_t process = 0;
pthread_t mainThread;
volatile std::sig_atomic_t killSignal = 0;

/// Ends the process, if need be when the handler of that signal is over.
void die(int number)
{
    static_cast<void>(std::signal(number, SIG_DFL));
    static_cast<void>(std::raise(number));
}

/// Has the interpreter come around to `onStop`. A child of a script dies at once, and so does a process that
/// cannot come around, by the second signal.
void onKill(int number)
{
    if (getpid() != process || killSignal != 0)
        die(number);
    else
    {
        killSignal = number;
        pthread_kill(mainThread, getStopSignal());
    }
}

/// What the interpreter calls for the stop signal.
void onStop(int, bp::object const&)
{
    if (killSignal != 0)
    {
        if (acts->beforeKill)
            acts->beforeKill();
        die(killSignal);
    }
    PyErr_SetNone(PyExc_KeyboardInterrupt);
    bp::throw_error_already_set();
}

/// Lets others alone, such as what the parent has the process ignore.
void replaceKillHandler(sighandler_t former, sighandler_t handler)
{
    for (int const number : {SIGTERM, SIGHUP})
    {
        struct sigaction action = {};
        sigaction(number, nullptr, &action);
        if (action.sa_handler != former)
            continue;
        action.sa_handler = handler;
        sigaction(number, &action, nullptr);
    }
}

/// Scripts are told that nobody hears of these signals, and can hear of them themselves.
void hearOfKills()
{
    process = getpid();
    mainThread = pthread_self();
    replaceKillHandler(SIG_DFL, &onKill);
}

} // namespace

/// The functions of `scriptRunner.py`.
struct Interpreter::Runner
{
    Runner()
    {
        constexpr char const* file = "<velmora>";
        names["__builtins__"] = bp::import("builtins");
        names["__name__"] = "scriptRunner";
        names["__file__"] = file;
        bp::handle<> const code(Py_CompileString(runnerSource, file, Py_file_input));
        bp::handle<>(PyEval_EvalCode(code.get(), names.ptr(), names.ptr()));
    }

    bp::object get(char const* function) const { return names[function]; }

    bp::dict names;
};

Interpreter::Interpreter(Acts itsActs) : _acts(std::move(itsActs)), _thread(pthread_self())
{
    start();
    acts = &_acts;
    // The function that is registered first is called last.
    bp::import("atexit").attr("register")(bp::make_function(&runLastAct));
    _runner = std::make_unique<Runner>();
    _runner->get("start")(toBytes(getModuleFolder()), getStopSignal(), bp::make_function(&onStop));
    hearOfKills();
    loadModules();
    _threadState = PyEval_SaveThread();
}

Interpreter::~Interpreter()
{
    finish(0);
}

int Interpreter::run(ScriptCall const& call)
{
    Kv::PythonLock const lock;
    _failure.clear();
    int status = 0;
    try
    {
        bp::list arguments;
        for (std::string const& argument : call.arguments)
            arguments.append(toBytes(argument));
        bp::object const prepared = _runner->get("prepare")(call.kind == ScriptCall::Kind::Module, toBytes(call.name),
                                                            toBytes(call.target), arguments);
        bp::object const function = prepared[0];
        bp::object const itsArguments = prepared[1];
        bp::handle<>(PyObject_CallObject(function.ptr(), itsArguments.ptr()));
    }
    catch (bp::error_already_set const&)
    {
        status = takeError();
    }
    catch (std::exception const& error)
    {
        status = 1;
        _failure = error.what();
        PySys_FormatStderr("%s\n", error.what());
    }
    attempt(
        [&]
        {
            if (status != 0)
                _runner->get("make_main")();
            _runner->get("flush")();
        });
    return status;
}

bool Interpreter::attempt(std::function<void()> const& action)
{
    Kv::PythonLock const lock;
    try
    {
        action();
        return true;
    }
    catch (bp::error_already_set const&)
    {
        bool const interrupted = PyErr_ExceptionMatches(PyExc_KeyboardInterrupt);
        if (interrupted)
            PyErr_Clear();
        else
            // Not as other errors are printed, which ends the process for `SystemExit`.
            PyErr_WriteUnraisable(nullptr);
        return !interrupted;
    }
}

bool Interpreter::isInterrupted()
{
    return !attempt(
        []
        {
            if (PyErr_CheckSignals() != 0)
                bp::throw_error_already_set();
        });
}

void Interpreter::stop() const
{
    pthread_kill(_thread, getStopSignal());
}

bool Interpreter::isRunning() const
{
    Kv::PythonLock const lock;
    bp::handle<> const frame(
        bp::allow_null(reinterpret_cast<PyObject*>(PyThreadState_GetFrame(static_cast<PyThreadState*>(_threadState)))));
    return frame.get();
}

void Interpreter::loadModules()
{
    try
    {
        bp::import("quorvane_velmora.ui");
    }
    catch (bp::error_already_set const&)
    {
        takeError();
        throw std::runtime_error("The module cannot be loaded: " + _failure);
    }
}

int Interpreter::finish(int status)
{
    if (!_threadState)
        return status;
    PyEval_RestoreThread(static_cast<PyThreadState*>(_threadState));
    _threadState = nullptr;
    _runner.reset();
    replaceKillHandler(&onKill, SIG_DFL);
    constexpr int lostOutput = 120;
    return Py_FinalizeEx() < 0 && status == 0 ? lostOutput : status;
}

int Interpreter::takeError()
{
    Kv::PythonError const error = Kv::PythonError::fetch();
    int status = 1;
    attempt(
        [&]
        {
            bp::object const report =
                _runner->get("report")(bp::object(bp::handle<>(bp::borrowed(error.getException()))));
            status = bp::extract<int>(report[0]);
            _failure = bp::extract<std::string>(report[1]);
        });
    return status;
}

} // namespace Velmora
