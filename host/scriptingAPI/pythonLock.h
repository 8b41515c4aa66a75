#pragma once

#include <Python.h>

namespace Kv
{

/// Holds the interpreter's lock, on any thread, also where that has it already.
class PythonLock
{
public:
    PythonLock() : _state(PyGILState_Ensure()) {}
    PythonLock(PythonLock const&) = delete;
    PythonLock& operator=(PythonLock const&) = delete;
    ~PythonLock() { PyGILState_Release(_state); }

private:
    PyGILState_STATE _state;
};

} // namespace Kv
