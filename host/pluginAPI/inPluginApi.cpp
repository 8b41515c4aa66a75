#include "pluginAPI/inPluginApi.h"

#include "base/inBase.h"
#include "base/inBuildInfoUtil.h"
#include "base/inLibraryBuildInfo.h"
#include "resmgt/inResmgt.h"

#include <memory>

namespace Kv
{

template <> std::type_info const* InInit<KvInit::pluginAPI>::getType()
{
    return &typeid(InInit);
}

template <> InInit<KvInit::pluginAPI>::InInit() : InPackageInit("pluginAPI")
{
    registerPackage();
    addDependency(InInit<KvInit::resmgt>::getType());
    addDependency(InInit<KvInit::base>::getType());
}

template <> void InInit<KvInit::pluginAPI>::initPackage()
{
    InBuildInfoUtil::registerInfo(std::make_unique<InLibraryBuildInfo>("libKVpluginAPI", __DATE__));
}

namespace
{

InInit<KvInit::pluginAPI> const record;

} // namespace

} // namespace Kv
