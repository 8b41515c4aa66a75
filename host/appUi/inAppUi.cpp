#include "appUi/inAppUi.h"

#include "base/inBase.h"
#include "base/inBuildInfoUtil.h"
#include "base/inLibraryBuildInfo.h"
#include "framework/inFramework.h"
#include "gfx/inGfx.h"
#include "internalAPI/inInternalApi.h"
#include "pluginAPI/inPluginApi.h"
#include "resmgt/inResmgt.h"
#include "ui/inUi.h"

#include <memory>

namespace Kv
{

template <> std::type_info const* InInit<KvInit::appUi>::getType()
{
    return &typeid(InInit);
}

template <> InInit<KvInit::appUi>::InInit() : InPackageInit("appUi")
{
    registerPackage();
    addDependency(InInit<KvInit::framework>::getType());
    addDependency(InInit<KvInit::internalAPI>::getType());
    addDependency(InInit<KvInit::pluginAPI>::getType());
    addDependency(InInit<KvInit::ui>::getType());
    addDependency(InInit<KvInit::gfx>::getType());
    addDependency(InInit<KvInit::resmgt>::getType());
    addDependency(InInit<KvInit::base>::getType());
}

template <> void InInit<KvInit::appUi>::initPackage()
{
    InBuildInfoUtil::registerInfo(std::make_unique<InLibraryBuildInfo>("libKVappUi", __DATE__));
}

namespace
{

InInit<KvInit::appUi> const record;

} // namespace

} // namespace Kv
