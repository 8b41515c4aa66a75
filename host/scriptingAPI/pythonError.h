#pragma once

#include <Python.h>

#include <boost/python/handle.hpp>

#include "kvExport.h"

namespace Kv
{

/// A Python error that was taken off the interpreter, to be put back later. Made, copied and dropped with the
/// interpreter lock held.
class KV_API PythonError
{
public:
    /// Takes the error that is set.
    static PythonError fetch();

    PythonError(PythonError const&);
    PythonError& operator=(PythonError const&);
    ~PythonError();

    /// The exception object, borrowed.
    PyObject* getException() const;

    /// Sets the error again.
    void restore() const;

    /// Makes `later` the last of the exceptions in whose context this one is shown. False if one of them is in the
    /// other's context already.
    bool addContext(PythonError const& later) const;

private:
    explicit PythonError(PyObject* exception) : _exception(exception) {}

    /// The exception object, with its traceback in it.
    boost::python::handle<> _exception;
};

} // namespace Kv
