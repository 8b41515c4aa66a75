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

#else

constexpr int importLevel = -1;

inline PyObject* stringFromStringAndSize(char const* text, Py_ssize_t size)
{
    return PyString_FromStringAndSize(text, size);
}

#endif

} // namespace Kv::PyextUi::PyCompat
