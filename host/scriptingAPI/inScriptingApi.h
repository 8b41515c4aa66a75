#pragma once

#include "base/inInit.h"
#include "scriptingAPI/kvScriptingApiExport.h"

namespace KvInit
{

/// Stands for libKVscriptingAPI among the packages.
class KVSCRIPTINGAPI_API scriptingAPI;

} // namespace KvInit

namespace Kv
{

template <> KVSCRIPTINGAPI_API std::type_info const* InInit<KvInit::scriptingAPI>::getType();

} // namespace Kv
