#include "scriptingAPI/inScriptingApi.h"

#include "base/inBase.h"
#include "base/inBuildInfoUtil.h"
#include "base/inLibraryBuildInfo.h"
#include "gfx/inGfx.h"
#include "resmgt/inResmgt.h"
#include "ui/inUi.h"

#include <memory>

namespace Kv
{

template <> std::type_info const* InInit<KvInit::scriptingAPI>::getType()
{
    return &typeid(InInit);
}

template <> InInit<KvInit::scriptingAPI>::InInit() : InPackageInit("scriptingAPI")
{
    registerPackage();
    addDependency(InInit<KvInit::ui>::getType());
    addDependency(InInit<KvInit::gfx>::getType());
    addDependency(InInit<KvInit::resmgt>::getType());
    addDependency(InInit<KvInit::base>::getType());
}

template <> void InInit<KvInit::scriptingAPI>::initPackage()
{
    InBuildInfoUtil::registerInfo(std::make_unique<InLibraryBuildInfo>("libKVscriptingAPI", __DATE__));
}

namespace
{

InInit<KvInit::scriptingAPI> const record;

} // namespace

} // namespace Kv
