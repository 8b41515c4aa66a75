#include <boost/python.hpp>

#include "pyManagedObject.h"
#include "pyModError.h"

#include <map>

namespace bp = boost::python;

namespace Kv
{

PyManagedObjectBase::PyManagedObjectBase(Uuid const& interpreterId) : _interpreterId(interpreterId) {}

PyManagedObjectBase::~PyManagedObjectBase() = default;

} // namespace Kv

namespace Kv::PyextInit
{

Error::Error(char const* sourcePath, int line, char const* modName, char const* reason)
    : ExBase(sourcePath, line, reason), _modName(modName)
{
}

Error::Error(Error const&) = default;

Error& Error::operator=(Error const&) = default;

Error::~Error() = default;

ExBase* Error::clone() const
{
    return new Error(*this);
}

void Error::raise() const
{
    throw Error(*this);
}

void* Error::newException(std::string const& modName, std::string const& className)
{
    static std::map<std::string, PyObject*> types;
    PyObject*& type = types[modName + "." + className];
    if (!type)
        type =
            bp::handle<>(PyErr_NewException((modName + "." + className).c_str(), PyExc_Exception, nullptr)).release();
    bp::scope current;
    if (current.ptr() != Py_None)
        current.attr(className.c_str()) = bp::object(bp::handle<>(bp::borrowed(type)));
    return type;
}

} // namespace Kv::PyextInit
