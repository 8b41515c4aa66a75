#pragma once

#include "kvExport.h"
#include "pyModError.h"

namespace Kv::PyextUi
{

/// Stands for this module where a template asks which one.
class KV_API Ui;

} // namespace Kv::PyextUi

namespace Kv::PyextInit
{

// One set of statics for all libraries.
extern template class KV_API ModError<PyextUi::Ui>;

} // namespace Kv::PyextInit

namespace Kv::PyextUi
{

/// What the module itself finds wrong. Scripts see it as `UiError`.
using UiError = PyextInit::ModError<Ui>;

} // namespace Kv::PyextUi
