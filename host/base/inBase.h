#pragma once

#include "base/inInit.h"
#include "base/kvBaseExport.h"

namespace KvInit
{

/// Stands for libKVbase among the packages.
class KVBASE_API base;

} // namespace KvInit

namespace Kv
{

template <> KVBASE_API std::type_info const* InInit<KvInit::base>::getType();

} // namespace Kv
