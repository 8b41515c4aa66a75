#include "pyCallables.h"

#include "pyCompat.h"
#include "pyWidgetCbs.h"

#include <boost/python/errors.hpp>

namespace bp = boost::python;

namespace Kv::PyextUi
{

namespace
{

bp::handle<> keyOf(CallbackSet const& set)
{
    return bp::handle<>(PyLong_FromVoidPtr(const_cast<CallbackSet*>(&set)));
}

} // namespace

PyCallables::PyCallables() : _dictionary(bp::handle<>(PyDict_New()).release()) {}

PyCallables::~PyCallables()
{
    Py_DECREF(_dictionary);
}

void PyCallables::add(CallbackSet const& set)
{
    if (PyDict_SetItem(_dictionary, keyOf(set).get(), set.callable) != 0)
        bp::throw_error_already_set();
}

void PyCallables::remove(CallbackSet const& set)
{
    if (find(set) && PyDict_DelItem(_dictionary, keyOf(set).get()) != 0)
        bp::throw_error_already_set();
}

bp::handle<> PyCallables::find(CallbackSet const& set) const
{
    PyObject* const callable = PyCompat::dictGetItem(_dictionary, keyOf(set).get());
    if (!callable && PyErr_Occurred())
        bp::throw_error_already_set();
    return bp::handle<>(bp::borrowed(bp::allow_null(callable)));
}

void PyCallables::addShare()
{
    if (_shares++ > 0)
        Py_INCREF(_dictionary);
}

void PyCallables::releaseShare()
{
    if (--_shares > 0)
        Py_DECREF(_dictionary);
}

} // namespace Kv::PyextUi
