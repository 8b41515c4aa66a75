#pragma once

#include "base/inInit.h"
#include "base/kvExport.h"

namespace KvInit
{

/// Stands for libKVscriptingAPI among the packages.
class KV_API scriptingAPI;

} // namespace KvInit

namespace Kv
{

template <> KV_API std::type_info const* InInit<KvInit::scriptingAPI>::getType();

} // namespace Kv
