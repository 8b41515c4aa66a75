#include "framework/inFramework.h"

#include "base/inBase.h"
#include "base/inBuildInfoUtil.h"
#include "base/inLibraryBuildInfo.h"
#include "internalAPI/inInternalApi.h"
#include "pluginAPI/inPluginApi.h"
#include "resmgt/inResmgt.h"

#include <memory>

namespace Kv
{

template <> std::type_info const* InInit<KvInit::framework>::getType()
{
    return &typeid(InInit);
}

template <> InInit<KvInit::framework>::InInit() : InPackageInit("framework")
{
    registerPackage();
    addDependency(InInit<KvInit::pluginAPI>::getType());
    addDependency(InInit<KvInit::internalAPI>::getType());
    addDependency(InInit<KvInit::resmgt>::getType());
    addDependency(InInit<KvInit::base>::getType());
}

template <> void InInit<KvInit::framework>::initPackage()
{
    InBuildInfoUtil::registerInfo(std::make_unique<InLibraryBuildInfo>("libKVframework", __DATE__));
}

namespace
{

InInit<KvInit::framework> const record;

} // namespace

} // namespace Kv
