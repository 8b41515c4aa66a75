#include <boost/python.hpp>

#include "files/osFilePath.h"
#include "pythonParts.h"

#include <cstddef>
#include <cstring>
#include <new>
#include <string>

namespace bp = boost::python;

namespace Kv
{

namespace
{

using bp::converter::rvalue_from_python_stage1_data;
using bp::converter::rvalue_from_python_storage;

/// Bytes of the file system that are no text come as lone surrogates, and go back as the same bytes.
bp::handle<> toPython(std::string const& path)
{
    return bp::handle<>(PyUnicode_DecodeFSDefaultAndSize(path.data(), static_cast<Py_ssize_t>(path.size())));
}

/// `str` and `bytes` as they are, else what `os.PathLike` objects give; a null handle with the Python error set.
bp::handle<> toBytes(PyObject* object)
{
    bp::handle<> const path(bp::allow_null(PyOS_FSPath(object)));
    if (!path || PyBytes_Check(path.get()))
        return path;
    return bp::handle<>(bp::allow_null(PyUnicode_EncodeFSDefault(path.get())));
}

struct FilePathToPython
{
    static PyObject* convert(OsFilePath const& path) { return bp::incref(toPython(path.toString()).get()); }
};

void* isPath(PyObject* object)
{
    bool const isConvertible = PyUnicode_Check(object) || PyBytes_Check(object) ||
                               PyObject_HasAttrString(reinterpret_cast<PyObject*>(Py_TYPE(object)), "__fspath__");
    return isConvertible ? object : nullptr;
}

void constructPath(PyObject* object, rvalue_from_python_stage1_data* data)
{
    bp::handle<> const bytes = toBytes(object);
    if (!bytes)
        bp::throw_error_already_set();
    std::string const path(PyBytes_AS_STRING(bytes.get()), static_cast<std::size_t>(PyBytes_GET_SIZE(bytes.get())));
    if (path.find('\0') != std::string::npos)
    {
        PyErr_SetString(PyExc_ValueError, "A path cannot hold a zero byte");
        bp::throw_error_already_set();
    }
    void* const storage = reinterpret_cast<rvalue_from_python_storage<OsFilePath>*>(data)->storage.bytes;
    data->convertible = new (storage) OsFilePath(path);
}

/// The same objects that Boost.Python itself takes.
void* isTruth(PyObject* object)
{
    return object == Py_None || PyLong_Check(object) ? object : nullptr;
}

void constructTruth(PyObject* object, rvalue_from_python_stage1_data* data)
{
    int const truth = PyObject_IsTrue(object);
    if (truth < 0)
        bp::throw_error_already_set();
    void* const storage = reinterpret_cast<rvalue_from_python_storage<bool>*>(data)->storage.bytes;
    data->convertible = new (storage) bool(truth > 0);
}

} // namespace

void installConverters()
{
    // Scripts see paths as `str`, wherever a function of any module takes or gives one.
    bp::to_python_converter<OsFilePath, FilePathToPython>();
    bp::converter::registry::push_back(&isPath, &constructPath, bp::type_id<OsFilePath>());
    // Before the converter of Boost.Python, which takes a truth that raises for true and leaves the error set.
    bp::converter::registry::insert(&isTruth, &constructTruth, bp::type_id<bool>());
}

} // namespace Kv
