#pragma once

#include "base/inInit.h"
#include "pyinit/kvPyextInitExport.h"

namespace KvInit
{

/// Stands for libKVpyextInit among the packages.
class KVPYEXTINIT_API pyextInit;

} // namespace KvInit

namespace Kv
{

template <> KVPYEXTINIT_API std::type_info const* InInit<KvInit::pyextInit>::getType();

} // namespace Kv
