#include "resmgt/inResmgt.h"

#include "base/inBase.h"
#include "base/inBuildInfoUtil.h"
#include "base/inLibraryBuildInfo.h"

#include <memory>

namespace Kv
{

template <> std::type_info const* InInit<KvInit::resmgt>::getType()
{
    return &typeid(InInit);
}

template <> InInit<KvInit::resmgt>::InInit() : InPackageInit("resmgt")
{
    registerPackage();
    addDependency(InInit<KvInit::base>::getType());
}

template <> void InInit<KvInit::resmgt>::initPackage()
{
    InBuildInfoUtil::registerInfo(std::make_unique<InLibraryBuildInfo>("libKVresmgt", __DATE__));
}

namespace
{

InInit<KvInit::resmgt> const record;

} // namespace

} // namespace Kv
