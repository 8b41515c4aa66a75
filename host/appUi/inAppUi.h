#pragma once

#include "appUi/kvAppUiExport.h"
#include "base/inInit.h"

namespace KvInit
{

/// Stands for libKVappUi among the packages.
class KVAPPUI_API appUi;

} // namespace KvInit

namespace Kv
{

template <> KVAPPUI_API std::type_info const* InInit<KvInit::appUi>::getType();

} // namespace Kv
