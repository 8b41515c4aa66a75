#include <boost/python.hpp>
#include <boost/python/object/find_instance.hpp>

#include "pyManagedDialog.h"

namespace bp = boost::python;

namespace Kv
{

template class PyManagedObject<RCShdPtr<PyextUi::Dialog>>;

} // namespace Kv

namespace Kv::PyextUi
{

namespace
{

class SharedManagedDialog : public ManagedDialog
{
public:
    explicit SharedManagedDialog(RCShdPtr<Dialog> const& dialog) : ManagedDialog(dialog)
    {
        dialog->getCallables().addShare();
    }
    SharedManagedDialog(SharedManagedDialog const&) = delete;
    SharedManagedDialog& operator=(SharedManagedDialog const&) = delete;
    ~SharedManagedDialog() override { getValue()->getCallables().releaseShare(); }
};

/// The callables that a Python object may report as its own: those of a dialog that nobody but such objects holds.
PyObject* findOwnedCallables(PyObject* self)
{
    auto const* const managed = static_cast<RCShdPtr<ManagedDialog> const*>(
        bp::objects::find_instance_impl(self, bp::type_id<RCShdPtr<ManagedDialog>>()));
    if (!managed || !dynamic_cast<SharedManagedDialog const*>(managed->get()) || (*managed)->getReferenceCount() != 1)
        return nullptr;
    Dialog& dialog = *(*managed)->getValue();
    return dialog.getReferenceCount() == dialog.getCallables().getShareCount() ? dialog.getCallables().getDictionary()
                                                                               : nullptr;
}

// Neither of the two calls the slot of the base class, which would find these again and never end.

int traverse(PyObject* self, visitproc visit, void* arg)
{
    Py_VISIT(Py_TYPE(self));
    if (PyObject* const* const dictionary = _PyObject_GetDictPtr(self))
        Py_VISIT(*dictionary);
    Py_VISIT(findOwnedCallables(self));
    return 0;
}

/// The callables are kept by their dictionary, which the collector clears itself.
int clear(PyObject* self)
{
    if (PyObject** const dictionary = _PyObject_GetDictPtr(self))
        Py_CLEAR(*dictionary);
    return 0;
}

} // namespace

RCShdPtr<ManagedDialog> makeManaged(RCShdPtr<Dialog> const& dialog)
{
    return RCShdPtr<ManagedDialog>(new SharedManagedDialog(dialog));
}

void supportGarbageCollection(PyTypeObject* dialogClass)
{
    dialogClass->tp_traverse = traverse;
    dialogClass->tp_clear = clear;
}

} // namespace Kv::PyextUi
