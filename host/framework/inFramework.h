#pragma once

#include "base/inInit.h"
#include "base/kvExport.h"

namespace KvInit
{

/// Stands for libKVframework among the packages.
class KV_API framework;

} // namespace KvInit

namespace Kv
{

template <> KV_API std::type_info const* InInit<KvInit::framework>::getType();

} // namespace Kv
