#pragma once

#include <Python.h>

namespace Kv::PyextUi::PyCompat
{

// The names that differ between Python 2 and Python 3.
#if PY_MAJOR_VERSION >= 3

/// Level for `PyImport_ImportModuleLevel`: absolute names only.
constexpr int importLevel = 0;

inline PyObject* stringFromStringAndSize(char const* text, Py_ssize_t size)
{
    return PyUnicode_FromStringAndSize(text, size);
}

/// Borrowed; null without an error for a key that is not there. The plain call drops every error, also that of a
/// recursion which is too deep.
inline PyObject* dictGetItem(PyObject* dictionary, PyObject* key)
{
    return PyDict_GetItemWithError(dictionary, key);
}

#else

constexpr int importLevel = -1;

inline PyObject* stringFromStringAndSize(char const* text, Py_ssize_t size)
{
    return PyString_FromStringAndSize(text, size);
}

inline PyObject* dictGetItem(PyObject* dictionary, PyObject* key)
{
    return _PyDict_GetItemWithError(dictionary, key);
}

#endif

} // namespace Kv::PyextUi::PyCompat
