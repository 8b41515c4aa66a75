#pragma once

#include "base/inInit.h"
#include "internalAPI/kvInternalApiExport.h"

namespace KvInit
{

/// Stands for libKVinternalAPI among the packages.
class KVINTERNALAPI_API internalAPI;

} // namespace KvInit

namespace Kv
{

template <> KVINTERNALAPI_API std::type_info const* InInit<KvInit::internalAPI>::getType();

} // namespace Kv
