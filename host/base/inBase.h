#pragma once

#include "base/inInit.h"
#include "base/kvExport.h"

namespace KvInit
{

/// Stands for libKVbase among the packages.
class KV_API base;

} // namespace KvInit

namespace Kv
{

template <> KV_API std::type_info const* InInit<KvInit::base>::getType();

} // namespace Kv
