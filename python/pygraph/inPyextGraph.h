#pragma once

#include "base/inInit.h"
#include "pygraph/kvPyextGraphExport.h"

namespace KvInit
{

/// Stands for libKVpyextGraph among the packages.
class KVPYEXTGRAPH_API pyextGraph;

} // namespace KvInit

namespace Kv
{

template <> KVPYEXTGRAPH_API std::type_info const* InInit<KvInit::pyextGraph>::getType();

} // namespace Kv
