#pragma once

#include "base/inInit.h"
#include "base/kvExport.h"

namespace KvInit
{

/// Stands for libKVpyextUi among the packages.
class KV_API pyextUi;

} // namespace KvInit

namespace Kv
{

template <> KV_API std::type_info const* InInit<KvInit::pyextUi>::getType();

} // namespace Kv
