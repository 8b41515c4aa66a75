#pragma once

#include "base/inInit.h"
#include "pluginAPI/kvPluginApiExport.h"

namespace KvInit
{

/// Stands for libKVpluginAPI among the packages.
class KVPLUGINAPI_API pluginAPI;

} // namespace KvInit

namespace Kv
{

template <> KVPLUGINAPI_API std::type_info const* InInit<KvInit::pluginAPI>::getType();

} // namespace Kv
