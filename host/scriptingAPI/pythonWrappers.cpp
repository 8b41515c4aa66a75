#include <boost/python.hpp>

#include "ntPlatform.h"
#include "pythonLock.h"
#include "pythonParts.h"
#include "wsNative.h"
#include "wsThread.h"

#include <string>
#include <unordered_map>
#include <unordered_set>
#include <utility>
#include <vector>

namespace bp = boost::python;

namespace Kv
{

namespace
{

/// Keeps the wrappers that PyQt6 makes of this application's own objects for as long as these live. What a script
/// connects to such an object is seen by the garbage collector through the wrapper alone: it would clear the function
/// along with the wrapper while Qt goes on calling it. Also takes the windows down before the interpreter does, since
/// scripts may hear of that.
class WrapperKeeper
{
public:
    static WrapperKeeper& getInstance()
    {
        // Never destroyed: what it keeps can only go with the interpreter, which has ended by then.
        static auto* const keeper = new WrapperKeeper;
        return *keeper;
    }

    void install()
    {
        // The import of a module can fail wherever a collection begins: the code that runs there may have no builtins.
        _getObjects = bp::import("gc").attr("get_objects");
        bp::import("gc").attr("callbacks").attr("append")(bp::make_function(&WrapperKeeper::onCollection));
        bp::import("atexit").attr("register")(bp::make_function(&WrapperKeeper::onExit));
    }

private:
    WrapperKeeper() = default;

    static void onCollection(bp::object const& phase, bp::object const&)
    {
        if (bp::extract<std::string>(phase)() == "start")
            getInstance().keepNew();
    }

    static void onExit()
    {
        NtPlatform* const platform = WsNative::getLoadedPlatform();
        if (platform && WsThread::isCurrent())
            platform->destroyWindows();
    }

    static bp::handle<> find(char const* module, char const* name)
    {
        PyObject* const found = PyDict_GetItemString(PyImport_GetModuleDict(), module);
        bp::handle<> const attribute(bp::allow_null(found ? PyObject_GetAttrString(found, name) : nullptr));
        PyErr_Clear();
        return attribute;
    }

    /// The address of what is wrapped; null where that is gone, or belongs to Python.
    static void* findObject(PyObject* wrapper)
    {
        bp::handle<> const isPythons = find("PyQt6.sip", "ispyowned");
        bp::handle<> const unwrap = find("PyQt6.sip", "unwrapinstance");
        if (!isPythons || !unwrap || bp::handle<>(PyObject_CallOneArg(isPythons.get(), wrapper)).get() == Py_True)
            return nullptr;
        bp::handle<> const address(bp::allow_null(PyObject_CallOneArg(unwrap.get(), wrapper)));
        void* const object = address ? PyLong_AsVoidPtr(address.get()) : nullptr;
        PyErr_Clear();
        return object;
    }

    /// Each wrapper comes by here before its first collection.
    void keepNew()
    {
        bp::handle<> const type = find("PyQt6.QtCore", "QObject");
        if (!type || !PyType_Check(type.get()))
            return;
        bp::object const young = _getObjects(0);
        for (Py_ssize_t i = 0; i < PyList_GET_SIZE(young.ptr()); ++i)
        {
            PyObject* const object = PyList_GET_ITEM(young.ptr(), i);
            if (PyObject_TypeCheck(object, reinterpret_cast<PyTypeObject*>(type.get())))
                _found.emplace_back(bp::borrowed(object));
        }
        // The finds of another thread wait until their objects can be looked at.
        NtPlatform* const platform = WsNative::getLoadedPlatform();
        if (!platform || !WsThread::isCurrent())
            return;
        std::unordered_multimap<void const*, bp::handle<>> wrappers;
        for (bp::handle<> const& wrapper : std::exchange(_found, {}))
            if (void const* const object = findObject(wrapper.get()))
                wrappers.emplace(object, wrapper);
        std::unordered_set<void const*> objects;
        for (auto const& [object, wrapper] : wrappers)
            objects.insert(object);
        platform->observe(objects, [](void const* object) { getInstance().release(object); });
        for (auto const& [object, wrapper] : wrappers)
            if (objects.count(object) > 0)
                _kept.emplace(object, wrapper);
    }

    void release(void const* object)
    {
        if (!Py_IsInitialized())
            return;
        PythonLock const lock;
        // Objects that go with them can come back here.
        std::vector<bp::handle<>> released;
        auto const [first, last] = _kept.equal_range(object);
        for (auto place = first; place != last; ++place)
            released.push_back(place->second);
        _kept.erase(first, last);
    }

    bp::object _getObjects;
    std::vector<bp::handle<>> _found;
    std::unordered_multimap<void const*, bp::handle<>> _kept;
};

} // namespace

void installWrapperKeeper()
{
    WrapperKeeper::getInstance().install();
}

} // namespace Kv
