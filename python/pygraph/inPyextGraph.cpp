#include "pygraph/inPyextGraph.h"

#include "base/inBase.h"
#include "base/inBuildInfoUtil.h"
#include "base/inLibraryBuildInfo.h"
#include "framework/inFramework.h"
#include "gfx/inGfx.h"
#include "internalAPI/inInternalApi.h"
#include "pluginAPI/inPluginApi.h"
#include "pyinit/inPyextInit.h"
#include "resmgt/inResmgt.h"
#include "scriptingAPI/inScriptingApi.h"

#include <memory>

namespace Kv
{

template <> std::type_info const* InInit<KvInit::pyextGraph>::getType()
{
    return &typeid(InInit);
}

template <> InInit<KvInit::pyextGraph>::InInit() : InPackageInit("pyextGraph")
{
    registerPackage();
    addDependency(InInit<KvInit::pyextInit>::getType());
    addDependency(InInit<KvInit::scriptingAPI>::getType());
    addDependency(InInit<KvInit::framework>::getType());
    addDependency(InInit<KvInit::internalAPI>::getType());
    addDependency(InInit<KvInit::pluginAPI>::getType());
    addDependency(InInit<KvInit::gfx>::getType());
    addDependency(InInit<KvInit::resmgt>::getType());
    addDependency(InInit<KvInit::base>::getType());
}

template <> void InInit<KvInit::pyextGraph>::initPackage()
{
    InBuildInfoUtil::registerInfo(std::make_unique<InLibraryBuildInfo>("libKVpyextGraph", __DATE__));
}

namespace
{

InInit<KvInit::pyextGraph> const record;

} // namespace

} // namespace Kv
