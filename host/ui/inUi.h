#pragma once

#include "base/inInit.h"
#include "base/kvExport.h"

namespace KvInit
{

/// Stands for libKVui among the packages.
class KV_API ui;

} // namespace KvInit

namespace Kv
{

template <> KV_API std::type_info const* InInit<KvInit::ui>::getType();

} // namespace Kv
