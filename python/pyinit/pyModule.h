#pragma once

#include "piPythonUtils.h"

#include <boost/python.hpp>

namespace Kv::PyextInit
{

/// The body of a module, behind the interpreter's part in the host.
template <void (*body)()> void initBody()
{
    PiPythonUtils::takePart();
    body();
}

/// Makes the extension module of that name by running its body; for the module's entry function. Where the body has
/// failed, Boost.Python would give the module all the same, and the interpreter would hide the failure behind its own.
template <void (*body)()> PyObject* initModule(char const* name)
{
    static PyModuleDef definition{
        PyModuleDef_HEAD_INIT, name, nullptr, -1, nullptr, nullptr, nullptr, nullptr, nullptr};
    PyObject* const module = boost::python::detail::init_module(definition, &initBody<body>);
    if (!PyErr_Occurred())
        return module;
    Py_XDECREF(module);
    return nullptr;
}

/// Makes the class of `T` the attribute `name` of the module whose body runs. False if there is no such class yet. The
/// package and the bare name of an extension module are two modules of one process, and its body runs for each. They
/// share their classes, so that objects of the one are good for the other.
template <typename T> bool shareClass(char const* name)
{
    namespace bp = boost::python;
    bp::converter::registration const* const known = bp::converter::registry::query(bp::type_id<T>());
    if (!known || !known->m_class_object)
        return false;
    bp::scope().attr(name) = bp::object(bp::handle<>(bp::borrowed(known->m_class_object)));
    return true;
}

} // namespace Kv::PyextInit
