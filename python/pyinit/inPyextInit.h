#pragma once

#include "base/inInit.h"
#include "base/kvExport.h"

namespace KvInit
{

/// Stands for libKVpyextInit among the packages.
class KV_API pyextInit;

} // namespace KvInit

namespace Kv
{

template <> KV_API std::type_info const* InInit<KvInit::pyextInit>::getType();

} // namespace Kv
