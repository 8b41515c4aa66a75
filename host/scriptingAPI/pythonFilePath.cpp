#include <boost/python.hpp>

#include "files/osFilePath.h"

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

void* isConvertible(PyObject* object)
{
    bool const isPath = PyUnicode_Check(object) || PyBytes_Check(object) ||
                        PyObject_HasAttrString(reinterpret_cast<PyObject*>(Py_TYPE(object)), "__fspath__");
    return isPath ? object : nullptr;
}

void construct(PyObject* object, rvalue_from_python_stage1_data* data)
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

/// Scripts see paths as `str`, wherever a function of any module takes or gives one.
class FilePathConverters
{
public:
    FilePathConverters()
    {
        bp::to_python_converter<OsFilePath, FilePathToPython>();
        bp::converter::registry::push_back(&isConvertible, &construct, bp::type_id<OsFilePath>());
    }
};

FilePathConverters const installedConverters;

} // namespace

} // namespace Kv
