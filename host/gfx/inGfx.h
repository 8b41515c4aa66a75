#pragma once

#include "base/inInit.h"
#include "gfx/kvGfxExport.h"

namespace KvInit
{

/// Stands for libKVgfx among the packages.
class KVGFX_API gfx;

} // namespace KvInit

namespace Kv
{

template <> KVGFX_API std::type_info const* InInit<KvInit::gfx>::getType();

} // namespace Kv
