#include "internalAPI/inInternalApi.h"

#include "base/inBase.h"
#include "base/inBuildInfoUtil.h"
#include "base/inLibraryBuildInfo.h"
#include "pluginAPI/inPluginApi.h"
#include "resmgt/inResmgt.h"

#include <memory>

namespace Kv
{

template <> std::type_info const* InInit<KvInit::internalAPI>::getType()
{
    return &typeid(InInit);
}

template <> InInit<KvInit::internalAPI>::InInit() : InPackageInit("internalAPI")
{
    registerPackage();
    addDependency(InInit<KvInit::pluginAPI>::getType());
    addDependency(InInit<KvInit::resmgt>::getType());
    addDependency(InInit<KvInit::base>::getType());
}

template <> void InInit<KvInit::internalAPI>::initPackage()
{
    InBuildInfoUtil::registerInfo(std::make_unique<InLibraryBuildInfo>("libKVinternalAPI", __DATE__));
}

namespace
{

InInit<KvInit::internalAPI> const record;

} // namespace

} // namespace Kv
