#pragma once

#include "base/inInit.h"
#include "base/kvExport.h"

namespace KvInit
{

/// Stands for libKVresmgt among the packages.
class KV_API resmgt;

} // namespace KvInit

namespace Kv
{

template <> KV_API std::type_info const* InInit<KvInit::resmgt>::getType();

} // namespace Kv
