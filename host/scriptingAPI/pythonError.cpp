#include "pythonError.h"

namespace Kv
{

namespace
{

using boost::python::allow_null;
using boost::python::handle;
using boost::python::incref;

handle<> contextOf(PyObject* exception)
{
    return handle<>(allow_null(PyException_GetContext(exception)));
}

bool isInContextOf(PyObject* exception, PyObject* other)
{
    for (handle<> next(boost::python::borrowed(other)); next; next = contextOf(next.get()))
        if (next.get() == exception)
            return true;
    return false;
}

} // namespace

PythonError PythonError::fetch()
{
    PyObject* type = nullptr;
    PyObject* value = nullptr;
    PyObject* traceback = nullptr;
    PyErr_Fetch(&type, &value, &traceback);
    PyErr_NormalizeException(&type, &value, &traceback);
    if (traceback)
        PyException_SetTraceback(value, traceback);
    Py_XDECREF(type);
    Py_XDECREF(traceback);
    return PythonError(value);
}

PythonError::PythonError(PythonError const&) = default;

PythonError& PythonError::operator=(PythonError const&) = default;

PythonError::~PythonError() = default;

PyObject* PythonError::getException() const
{
    return _exception.get();
}

void PythonError::restore() const
{
    PyObject* const value = _exception.get();
    PyErr_Restore(incref(reinterpret_cast<PyObject*>(Py_TYPE(value))), incref(value), PyException_GetTraceback(value));
}

bool PythonError::addContext(PythonError const& later) const
{
    if (isInContextOf(_exception.get(), later._exception.get()))
        return false;
    handle<> last = _exception;
    for (handle<> next = last; next; next = contextOf(last.get()))
    {
        if (next.get() == later._exception.get())
            return false;
        last = next;
    }
    PyException_SetContext(last.get(), incref(later._exception.get()));
    return true;
}

} // namespace Kv
