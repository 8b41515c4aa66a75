#pragma once

#include <Python.h>

namespace Kv::PyextUi
{

/// Takes the Python error that is set off the interpreter for as long as it lives. Windows that go can make others run
/// Python code, while an exception is on its way through the one who held the dialog.
class ErrorAside
{
public:
    ErrorAside() { PyErr_Fetch(&_type, &_value, &_traceback); }
    ErrorAside(ErrorAside const&) = delete;
    ErrorAside& operator=(ErrorAside const&) = delete;
    ~ErrorAside() { PyErr_Restore(_type, _value, _traceback); }

private:
    PyObject* _type = nullptr;
    PyObject* _value = nullptr;
    PyObject* _traceback = nullptr;
};

} // namespace Kv::PyextUi
