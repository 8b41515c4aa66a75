#pragma once

#include <Python.h>

#include <boost/python/module_init.hpp>

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

/// The bytes of a path as scripts see paths.
inline PyObject* pathFromStringAndSize(char const* path, Py_ssize_t size)
{
    return PyUnicode_DecodeFSDefaultAndSize(path, size);
}

/// Boost.Python gives the module also where its body has failed, which the interpreter takes for a fault of its own.
inline PyObject* initModule(PyModuleDef& definition, void (*body)())
{
    PyObject* const module = boost::python::detail::init_module(definition, body);
    if (!PyErr_Occurred())
        return module;
    Py_XDECREF(module);
    return nullptr;
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

inline PyObject* pathFromStringAndSize(char const* path, Py_ssize_t size)
{
    return PyString_FromStringAndSize(path, size);
}

inline PyObject* dictGetItem(PyObject* dictionary, PyObject* key)
{
    return PyDict_GetItem(dictionary, key);
}

#endif

} // namespace Kv::PyextUi::PyCompat
