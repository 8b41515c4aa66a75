#include "pythonError.h"

#include <algorithm>
#include <unordered_set>
#include <vector>

namespace Kv
{

namespace
{

using boost::python::allow_null;
using boost::python::handle;
using boost::python::incref;

/// An exception, what it came from, and so on. A script can make a ring of that: it ends where it would begin anew.
class Chain
{
public:
    explicit Chain(handle<> const& exception)
    {
        for (handle<> next = exception; next && _known.insert(next.get()).second;
             next = handle<>(allow_null(PyException_GetContext(next.get()))))
            _exceptions.push_back(next);
    }

    bool contains(handle<> const& exception) const { return _known.count(exception.get()) > 0; }

    /// The last that the other chain does not have.
    handle<> findLastBeside(Chain const& other) const
    {
        return *std::find_if(_exceptions.rbegin(), _exceptions.rend(),
                             [&other](handle<> const& exception) { return !other.contains(exception); });
    }

private:
    std::vector<handle<>> _exceptions;
    std::unordered_set<PyObject*> _known;
};

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
    Chain const ours(_exception);
    Chain const theirs(later._exception);
    if (ours.contains(later._exception) || theirs.contains(_exception))
        return false;
    // What both came from stays behind the later one.
    PyException_SetContext(ours.findLastBeside(theirs).get(), incref(later._exception.get()));
    return true;
}

} // namespace Kv
