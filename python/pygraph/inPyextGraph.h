#pragma once

#include "base/inInit.h"
#include "base/kvExport.h"

namespace KvInit
{

/// Stands for libKVpyextGraph among the packages.
class KV_API pyextGraph;

} // namespace KvInit

namespace Kv
{

template <> KV_API std::type_info const* InInit<KvInit::pyextGraph>::getType();

} // namespace Kv
