#pragma once

#include "base/inInit.h"
#include "base/kvExport.h"

namespace KvInit
{

/// Stands for libKVappUi among the packages.
class KV_API appUi;

} // namespace KvInit

namespace Kv
{

template <> KV_API std::type_info const* InInit<KvInit::appUi>::getType();

} // namespace Kv
