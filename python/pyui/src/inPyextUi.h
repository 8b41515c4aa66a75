#pragma once

#include "base/inInit.h"
#include "kvPyextUiExport.h"

namespace KvInit
{

/// Stands for libKVpyextUi among the packages.
class KVPYEXTUI_API pyextUi;

} // namespace KvInit

namespace Kv
{

template <> KVPYEXTUI_API std::type_info const* InInit<KvInit::pyextUi>::getType();

} // namespace Kv
