#pragma once

#include "pyDialog.h"
#include "pyManagedObject.h"

#include <boost/python/pointee.hpp>

namespace Kv
{

/// What Python objects keep of a dialog.
using ManagedDialog = PyManagedObject<RCShdPtr<PyextUi::Dialog>>;

extern template class KV_API PyManagedObject<RCShdPtr<PyextUi::Dialog>>;

/// The dialog in a wrapper; null for a wrapper around none. A null pointer to a wrapper throws `ExNullPtr`.
inline PyextUi::Dialog* get_pointer(RCShdPtr<ManagedDialog> const& managed)
{
    return managed->getValue().get();
}

namespace PyextUi
{

/// A new wrapper for one Python object, which shares the dialog's callables for as long as it lives.
RCShdPtr<ManagedDialog> makeManaged(RCShdPtr<Dialog> const& dialog);

/// Lets Python's garbage collector see what instances of the class `Dialog` own: to be called right after the class was
/// made.
void supportGarbageCollection(PyTypeObject* dialogClass);

} // namespace PyextUi

} // namespace Kv

namespace boost::python
{

template <> struct pointee<Kv::RCShdPtr<Kv::ManagedDialog>>
{
    using type = Kv::PyextUi::Dialog;
};

} // namespace boost::python
