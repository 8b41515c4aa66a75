#include <boost/python.hpp>

#include "pythonLock.h"
#include "pythonParts.h"
#include "uiResTable.h"

#include <filesystem>
#include <string>
#include <system_error>

namespace bp = boost::python;

namespace Kv
{

namespace
{

/// The file that `__main__` was read from; empty for a script that has none, as one that is typed.
std::string getScriptFile()
{
    PyObject* const main = PyImport_AddModule("__main__");
    PyObject* const file = main ? PyDict_GetItemString(PyModule_GetDict(main), "__file__") : nullptr;
    bp::handle<> const bytes(bp::allow_null(file && PyUnicode_Check(file) ? PyUnicode_EncodeFSDefault(file) : nullptr));
    PyErr_Clear();
    return bytes ? PyBytes_AS_STRING(bytes.get()) : "";
}

/// The folder that a script imports from, with links followed.
std::string getScriptFolder()
{
    if (!Py_IsInitialized())
        return "";
    PythonLock const lock;
    std::string const file = getScriptFile();
    std::error_code isNone;
    std::filesystem::path const real = std::filesystem::canonical(file, isNone);
    return isNone ? "" : real.parent_path().string();
}

} // namespace

void installScriptFolder()
{
    UiResTable::setScriptFolder(&getScriptFolder);
}

} // namespace Kv
