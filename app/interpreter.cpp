#include <boost/python.hpp>

#include "interpreter.h"

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <memory>
#include <utility>

namespace bp = boost::python;

namespace Velmora
{

namespace
{

constexpr int interruptedStatus = 130;

class InterpreterHold
{
public:
    InterpreterHold() : _state(PyGILState_Ensure()) {}
    InterpreterHold(InterpreterHold const&) = delete;
    InterpreterHold& operator=(InterpreterHold const&) = delete;
    ~InterpreterHold() { PyGILState_Release(_state); }

private:
    PyGILState_STATE _state;
};

struct FileCloser
{
    void operator()(std::FILE* file) const { static_cast<void>(std::fclose(file)); }
};

bp::object toPython(std::string const& bytes)
{
    return bp::object(
        bp::handle<>(PyUnicode_DecodeFSDefaultAndSize(bytes.data(), static_cast<Py_ssize_t>(bytes.size()))));
}

/// The modules lie beside the folder of this program.
std::filesystem::path getModuleFolder()
{
    return std::filesystem::canonical("/proc/self/exe").parent_path().parent_path() / "python";
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

bp::object getSys()
{
    return bp::import("sys");
}

/// A new `__main__`, in place of the one before and of all that it had.
bp::dict makeMain()
{
    bp::object const module(bp::handle<>(PyModule_New("__main__")));
    bp::dict names = bp::extract<bp::dict>(module.attr("__dict__"));
    names["__builtins__"] = bp::import("builtins");
    names["__annotations__"] = bp::dict();
    // A script can have put anything in the place of `sys.modules`.
    if (PyDict_SetItemString(PyImport_GetModuleDict(), "__main__", module.ptr()) != 0)
        bp::throw_error_already_set();
    // A dialog of the one before, and the functions that hear of its events, hold each other.
    PyGC_Collect();
    return names;
}

/// What scripts import from first: only the one that runs now has its folder there.
void setFirstPath(bp::object const& folder)
{
    static PyObject* former = nullptr;
    bp::list path = bp::extract<bp::list>(getSys().attr("path"));
    if (former && bp::len(path) > 0 && bp::object(path[0]).ptr() == former)
        path.pop(0);
    path.insert(0, folder);
    Py_XDECREF(former);
    former = bp::incref(folder.ptr());
}

void runModule(std::string const& name, bool isNamed)
{
    makeMain();
    bp::import("runpy").attr("_run_module_as_main")(toPython(name), isNamed);
}

[[noreturn]] void failToOpen(std::string const& path, int error)
{
    errno = error;
    PyErr_SetFromErrnoWithFilenameObject(PyExc_OSError, toPython(path).ptr());
    bp::throw_error_already_set();
    throw std::logic_error("unreachable");
}

void runFile(std::string const& path)
{
    std::unique_ptr<std::FILE, FileCloser> const file(std::fopen(path.c_str(), "rb"));
    if (!file)
        failToOpen(path, errno);
    bp::object const name = toPython(path);
    bp::dict names = makeMain();
    names["__file__"] = name;
    names["__cached__"] = bp::object();
    names["__loader__"] = bp::import("importlib.machinery").attr("SourceFileLoader")("__main__", name);
    bp::handle<>(PyRun_FileExFlags(file.get(), path.c_str(), Py_file_input, names.ptr(), names.ptr(), 0, nullptr));
}

/// A folder or an archive with a module `__main__` in it is a script too.
bool holdsModules(std::string const& path)
{
    bp::handle<> const importer(PyImport_GetImporter(toPython(path).ptr()));
    return importer.get() != Py_None;
}

void setArguments(std::string const& first, std::vector<std::string> const& others)
{
    bp::list arguments;
    arguments.append(toPython(first));
    for (std::string const& argument : others)
        arguments.append(toPython(argument));
    getSys().attr("argv") = arguments;
}

void runCall(ScriptCall const& call)
{
    namespace fs = std::filesystem;
    if (call.kind == ScriptCall::Kind::Module)
    {
        setArguments("-m", call.arguments);
        std::error_code nowhere;
        setFirstPath(toPython(fs::current_path(nowhere)));
        runModule(call.target, true);
        return;
    }
    setArguments(call.name, call.arguments);
    if (holdsModules(call.target))
    {
        setFirstPath(toPython(call.target));
        runModule("__main__", false);
        return;
    }
    std::error_code unresolved;
    fs::path const real = fs::canonical(call.target, unresolved);
    setFirstPath(toPython((unresolved ? fs::path(call.target) : real).parent_path()));
    runFile(call.target);
}

void flushOutput()
{
    for (char const* const name : {"stdout", "stderr"})
    {
        PyObject* const stream = PySys_GetObject(name);
        if (stream && stream != Py_None && !bp::handle<>(bp::allow_null(PyObject_CallMethod(stream, "flush", nullptr))))
            PyErr_Clear();
    }
}

/// An error in one line, as the last of a traceback.
std::string describe(PyObject* value)
{
    bp::handle<> const text(bp::allow_null(PyObject_Str(value)));
    char const* const words = text ? PyUnicode_AsUTF8(text.get()) : nullptr;
    PyErr_Clear();
    std::string const type = Py_TYPE(value)->tp_name;
    return words && *words ? type + ": " + words : type;
}

/// The status that `SystemExit` asks for; a text is printed.
int readExit(PyObject* value)
{
    bp::handle<> const code(bp::allow_null(PyObject_GetAttrString(value, "code")));
    if (!code || code.get() == Py_None)
        return 0;
    if (PyLong_Check(code.get()))
    {
        auto const status = static_cast<int>(PyLong_AsLong(code.get()) & 0xff);
        PyErr_Clear();
        return status;
    }
    PyObject* const stream = PySys_GetObject("stderr");
    if (stream && stream != Py_None)
    {
        PyFile_WriteObject(code.get(), stream, Py_PRINT_RAW);
        PyFile_WriteString("\n", stream);
    }
    PyErr_Clear();
    return 1;
}

/// As the interpreter itself would, but that nothing of it is kept, where a dialog could live on in it, and that a hook
/// which raises `SystemExit` ends nothing.
void print(PyObject* type, PyObject* value, PyObject* traceback)
{
    if (traceback)
        PyException_SetTraceback(value, traceback);
    PyObject* const hook = PySys_GetObject("excepthook");
    if (!hook || hook == Py_None)
    {
        PyErr_Display(type, value, traceback);
        return;
    }
    bp::handle<> const held(bp::borrowed(hook));
    bp::handle<> const printed(
        bp::allow_null(PyObject_CallFunctionObjArgs(hook, type, value, traceback ? traceback : Py_None, nullptr)));
    if (!printed)
        PyErr_WriteUnraisable(hook);
}

/// What the Python binding of the toolkit takes for a hook of the script's own: with the interpreter's it ends the
/// process for an exception in a slot.
void setExceptionHook()
{
    bp::object const original = getSys().attr("__excepthook__");
    getSys().attr("excepthook") = bp::import("functools").attr("partial")(original);
}

/// What stops a script. Ctrl-C's own is ignored in a process that a shell has started in the background, and a script
/// may do with it what it likes.
int getStopSignal()
{
    return SIGRTMAX - 1;
}

/// Borrowed from the one interpreter.
std::function<void()> const* lastAct = nullptr;

void runLastAct()
{
    if (*lastAct)
        (*lastAct)();
}

} // namespace

Interpreter::Interpreter(std::function<void()> atEnd) : _atEnd(std::move(atEnd)), _thread(pthread_self())
{
    start();
    lastAct = &_atEnd;
    // What is registered first is called last.
    bp::import("atexit").attr("register")(bp::make_function(&runLastAct));
    bp::object const signals = bp::import("signal");
    signals.attr("signal")(getStopSignal(), bp::object(signals.attr("default_int_handler")));
    bp::list path = bp::extract<bp::list>(getSys().attr("path"));
    path.append(toPython(getModuleFolder()));
    setExceptionHook();
    loadModules();
    _threadState = PyEval_SaveThread();
}

Interpreter::~Interpreter()
{
    finish(0);
}

int Interpreter::run(ScriptCall const& call)
{
    InterpreterHold const hold;
    _failure.clear();
    int status = 0;
    try
    {
        runCall(call);
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
    if (status != 0)
        attempt([] { makeMain(); });
    flushOutput();
    return status;
}

bool Interpreter::attempt(std::function<void()> const& action)
{
    InterpreterHold const hold;
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
    InterpreterHold const hold;
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
    constexpr int lostOutput = 120;
    return Py_FinalizeEx() < 0 && status == 0 ? lostOutput : status;
}

int Interpreter::takeError()
{
    PyObject* type = nullptr;
    PyObject* value = nullptr;
    PyObject* traceback = nullptr;
    PyErr_Fetch(&type, &value, &traceback);
    PyErr_NormalizeException(&type, &value, &traceback);
    bp::handle<> const held(bp::borrowed(value));
    if (PyErr_GivenExceptionMatches(value, PyExc_SystemExit))
    {
        Py_XDECREF(type);
        Py_XDECREF(traceback);
        Py_DECREF(value);
        return readExit(held.get());
    }
    _failure = describe(value);
    bool const interrupted = PyErr_GivenExceptionMatches(value, PyExc_KeyboardInterrupt);
    print(type, value, traceback);
    Py_XDECREF(type);
    Py_XDECREF(value);
    Py_XDECREF(traceback);
    return interrupted ? interruptedStatus : 1;
}

} // namespace Velmora
