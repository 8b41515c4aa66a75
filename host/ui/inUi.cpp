#include "ui/inUi.h"

#include "base/inBase.h"
#include "base/inBuildInfoUtil.h"
#include "base/inLibraryBuildInfo.h"
#include "gfx/inGfx.h"
#include "resmgt/inResmgt.h"

#include <memory>

namespace Kv
{

template <> std::type_info const* InInit<KvInit::ui>::getType()
{
    return &typeid(InInit);
}

template <> InInit<KvInit::ui>::InInit() : InPackageInit("ui")
{
    registerPackage();
    addDependency(InInit<KvInit::gfx>::getType());
    addDependency(InInit<KvInit::resmgt>::getType());
    addDependency(InInit<KvInit::base>::getType());
}

template <> void InInit<KvInit::ui>::initPackage()
{
    InBuildInfoUtil::registerInfo(std::make_unique<InLibraryBuildInfo>("libKVui", __DATE__));
}

namespace
{

InInit<KvInit::ui> const record;

} // namespace

} // namespace Kv
