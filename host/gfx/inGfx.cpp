#include "gfx/inGfx.h"

#include "base/inBase.h"
#include "base/inBuildInfoUtil.h"
#include "base/inLibraryBuildInfo.h"
#include "resmgt/inResmgt.h"

#include <memory>

namespace Kv
{

template <> std::type_info const* InInit<KvInit::gfx>::getType()
{
    return &typeid(InInit);
}

template <> InInit<KvInit::gfx>::InInit() : InPackageInit("gfx")
{
    registerPackage();
    addDependency(InInit<KvInit::resmgt>::getType());
    addDependency(InInit<KvInit::base>::getType());
}

template <> void InInit<KvInit::gfx>::initPackage()
{
    InBuildInfoUtil::registerInfo(std::make_unique<InLibraryBuildInfo>("libKVgfx", __DATE__));
}

namespace
{

InInit<KvInit::gfx> const record;

} // namespace

} // namespace Kv
