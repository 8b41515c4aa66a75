#pragma once

#include "kvPyextUiExport.h"
#include "pyinit/pyModError.h"

namespace Kv::PyextUi
{

/// Stands for this module where a template asks which one.
class KVPYEXTUI_API Ui;

} // namespace Kv::PyextUi

namespace Kv::PyextInit
{

// One set of statics for all libraries.
extern template class KVPYEXTUI_API ModError<PyextUi::Ui>;

} // namespace Kv::PyextInit

namespace Kv::PyextUi
{

/// What the module itself finds wrong. Scripts see it as `UiError`.
using UiError = PyextInit::ModError<Ui>;

} // namespace Kv::PyextUi
