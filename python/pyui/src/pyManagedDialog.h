#pragma once

#include "pyDialog.h"
#include "pyManagedObject.h"

namespace Kv
{

/// The wrapper that Python objects keep of a dialog.
using ManagedDialog = PyManagedObject<RCShdPtr<PyextUi::Dialog>>;

extern template class KV_API PyManagedObject<RCShdPtr<PyextUi::Dialog>>;

namespace PyextUi
{

/// A new wrapper for one Python object, which shares the dialog's callables for as long as it lives.
RCShdPtr<ManagedDialog> makeManaged(RCShdPtr<Dialog> const& dialog);

/// Lets Python's garbage collector see what instances of the class `Dialog` own: to be called right after the class was
/// made.
void supportGarbageCollection(PyTypeObject* dialogClass);

} // namespace PyextUi

} // namespace Kv
