#pragma once

#include "base/inInit.h"
#include "base/kvExport.h"

namespace KvInit
{

/// Stands for libKVpluginAPI among the packages.
class KV_API pluginAPI;

} // namespace KvInit

namespace Kv
{

template <> KV_API std::type_info const* InInit<KvInit::pluginAPI>::getType();

} // namespace Kv
