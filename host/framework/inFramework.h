#pragma once

#include "base/inInit.h"
#include "framework/kvFrameworkExport.h"

namespace KvInit
{

/// Stands for libKVframework among the packages.
class KVFRAMEWORK_API framework;

} // namespace KvInit

namespace Kv
{

template <> KVFRAMEWORK_API std::type_info const* InInit<KvInit::framework>::getType();

} // namespace Kv
