#pragma once

#include "base/inInit.h"
#include "base/kvExport.h"

namespace KvInit
{

/// Stands for libKVinternalAPI among the packages.
class KV_API internalAPI;

} // namespace KvInit

namespace Kv
{

template <> KV_API std::type_info const* InInit<KvInit::internalAPI>::getType();

} // namespace Kv
