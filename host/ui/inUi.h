#pragma once

#include "base/inInit.h"
#include "ui/kvUiExport.h"

namespace KvInit
{

/// Stands for libKVui among the packages.
class KVUI_API ui;

} // namespace KvInit

namespace Kv
{

template <> KVUI_API std::type_info const* InInit<KvInit::ui>::getType();

} // namespace Kv
