#include <boost/python.hpp>

#include "pyInitError.h"

#include <map>

namespace Kv::PyextInit
{

namespace bp = boost::python;

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
    std::string const fullName = modName + "." + className;
    auto type = types.find(fullName);
    if (type == types.end())
    {
        bp::handle<> created(PyErr_NewException(fullName.c_str(), PyExc_Exception, nullptr));
        type = types.emplace(fullName, created.release()).first;
    }
    bp::scope current;
    if (current.ptr() != Py_None)
        current.attr(className.c_str()) = bp::object(bp::handle<>(bp::borrowed(type->second)));
    return type->second;
}

} // namespace Kv::PyextInit
