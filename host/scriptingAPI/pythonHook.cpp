#include "pythonError.h"
#include "pythonParts.h"
#include "wsNative.h"

#include <boost/python/errors.hpp>

#include <optional>

namespace Kv
{

namespace
{

/// The Python interpreter's part in the native loop.
class PythonHook : public NtScriptHook
{
public:
    int enter() noexcept override { return PyGILState_Ensure(); }

    void leave(int before) noexcept override { PyGILState_Release(static_cast<PyGILState_STATE>(before)); }

    int getDepth() noexcept override
    {
        PyThreadState const* const state = PyGILState_GetThisThreadState();
        return state ? state->gilstate_counter : 0;
    }

    std::exception_ptr capture() noexcept override
    {
        try
        {
            throw;
        }
        catch (boost::python::error_already_set const&)
        {
            std::exception_ptr const error = takeError();
            return error ? error : std::current_exception();
        }
        catch (...)
        {
            return std::current_exception();
        }
    }

    [[noreturn]] void rethrow(std::exception_ptr const& error) override
    {
        try
        {
            std::rethrow_exception(error);
        }
        catch (PythonError const& pythonError)
        {
            pythonError.restore();
            throw boost::python::error_already_set();
        }
    }

    std::exception_ptr takeError() noexcept override
    {
        bool const isHeld = PyGILState_GetThisThreadState() && PyGILState_Check() == 1;
        return isHeld && PyErr_Occurred() ? std::make_exception_ptr(PythonError::fetch()) : nullptr;
    }

    void putErrorBack(std::exception_ptr const& error) noexcept override
    {
        if (std::optional<PythonError> const pythonError = find(error))
            pythonError->restore();
    }

    void addContext(std::exception_ptr const& first, std::exception_ptr const& later) noexcept override
    {
        std::optional<PythonError> const firstError = find(first);
        std::optional<PythonError> const laterError = find(later);
        if (!firstError || !laterError || !firstError->addContext(*laterError))
            report(later);
    }

    void report(std::exception_ptr const& error) noexcept override
    {
        try
        {
            std::rethrow_exception(error);
        }
        catch (PythonError const& pythonError)
        {
            pythonError.restore();
            PyErr_WriteUnraisable(nullptr);
        }
        catch (std::exception const& exception)
        {
            PySys_WriteStderr("Exception in an event handler: %.900s\n", exception.what());
        }
        catch (...)
        {
            PySys_WriteStderr("Unknown exception in an event handler\n");
        }
    }

    void checkSignals() override
    {
        if (PyErr_CheckSignals() != 0)
            boost::python::throw_error_already_set();
    }

    void interrupt() noexcept override { PyErr_SetInterrupt(); }

    void callAtThreadEnd(void (*call)()) noexcept override
    {
        PyObject* const belongings = PyThreadState_GetDict();
        if (!belongings || PyDict_GetItemString(belongings, threadEndKey))
            return;
        PyObject* const end = PyCapsule_New(reinterpret_cast<void*>(call), threadEndKey, &callBack);
        if (!end || PyDict_SetItemString(belongings, threadEndKey, end) != 0)
            PyErr_Clear();
        Py_XDECREF(end);
    }

private:
    static constexpr char const* threadEndKey = "velmora.threadEnd";

    static void callBack(PyObject* end) { reinterpret_cast<void (*)()>(PyCapsule_GetPointer(end, threadEndKey))(); }

    static std::optional<PythonError> find(std::exception_ptr const& error) noexcept
    {
        try
        {
            std::rethrow_exception(error);
        }
        catch (PythonError const& pythonError)
        {
            return pythonError;
        }
        catch (...)
        {
            return std::nullopt;
        }
    }
};

} // namespace

void installHook()
{
    static PythonHook hook;
    WsNative::setScriptHook(&hook);
}

} // namespace Kv
