#include <boost/python.hpp>

#include <new>

namespace bp = boost::python;

namespace Kv
{

namespace
{

using bp::converter::rvalue_from_python_stage1_data;
using bp::converter::rvalue_from_python_storage;

/// The same objects that Boost.Python itself takes.
void* isConvertible(PyObject* object)
{
    return object == Py_None || PyLong_Check(object) ? object : nullptr;
}

void construct(PyObject* object, rvalue_from_python_stage1_data* data)
{
    int const truth = PyObject_IsTrue(object);
    if (truth < 0)
        bp::throw_error_already_set();
    void* const storage = reinterpret_cast<rvalue_from_python_storage<bool>*>(data)->storage.bytes;
    data->convertible = new (storage) bool(truth > 0);
}

/// Stands before the converter of Boost.Python, which takes a truth that raises for true and leaves the error set.
class TruthConverter
{
public:
    TruthConverter() { bp::converter::registry::insert(&isConvertible, &construct, bp::type_id<bool>()); }
};

TruthConverter const installedConverter;

} // namespace

} // namespace Kv
