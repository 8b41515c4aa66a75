#pragma once

#include <Python.h>

#include <boost/python/handle.hpp>

namespace Kv
{

struct CallbackSet;

namespace PyextUi
{

/// The callables of a dialog's script callbacks, kept in a Python dictionary, so that Python's garbage collector can
/// follow a callable that refers to its own dialog. Each Python object that shares the dialog has a reference of its
/// own to the dictionary, which it reports to the collector; while there is no such object, the dialog has the one
/// reference.
class PyCallables
{
public:
    PyCallables();
    PyCallables(PyCallables const&) = delete;
    PyCallables& operator=(PyCallables const&) = delete;
    ~PyCallables();

    void add(CallbackSet const& set);
    void remove(CallbackSet const& set);

    /// The callable of a set; null once it was removed, or taken by the collector.
    boost::python::handle<> find(CallbackSet const& set) const;

    /// One more Python object shares the dialog, or one less.
    void addShare();
    void releaseShare();
    int getShareCount() const { return _shares; }

    /// Borrowed, for the collector.
    PyObject* getDictionary() const { return _dictionary; }

private:
    PyObject* _dictionary;
    int _shares = 0;
};

} // namespace PyextUi

} // namespace Kv
