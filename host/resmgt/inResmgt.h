#pragma once

#include "base/inInit.h"
#include "resmgt/kvResmgtExport.h"

namespace KvInit
{

/// Stands for libKVresmgt among the packages.
class KVRESMGT_API resmgt;

} // namespace KvInit

namespace Kv
{

template <> KVRESMGT_API std::type_info const* InInit<KvInit::resmgt>::getType();

} // namespace Kv
