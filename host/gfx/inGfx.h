#pragma once

#include "base/inInit.h"
#include "base/kvExport.h"

namespace KvInit
{

/// Stands for libKVgfx among the packages.
class KV_API gfx;

} // namespace KvInit

namespace Kv
{

template <> KV_API std::type_info const* InInit<KvInit::gfx>::getType();

} // namespace Kv
