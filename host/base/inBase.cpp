#include "base/inBase.h"

#include "base/inBuildInfoUtil.h"
#include "base/inLibraryBuildInfo.h"

#include <memory>

namespace Kv
{

template <> std::type_info const* InInit<KvInit::base>::getType()
{
    return &typeid(InInit);
}

template <> InInit<KvInit::base>::InInit() : InPackageInit("base")
{
    registerPackage();
}

template <> void InInit<KvInit::base>::initPackage()
{
    InBuildInfoUtil::registerInfo(std::make_unique<InLibraryBuildInfo>("libKVbase", __DATE__));
}

namespace
{

InInit<KvInit::base> const record;

} // namespace

} // namespace Kv
