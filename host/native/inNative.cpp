#include "base/inBase.h"
#include "base/inBuildInfoUtil.h"
#include "base/inInit.h"
#include "base/inLibraryBuildInfo.h"
#include "resmgt/inResmgt.h"

#include <memory>

namespace KvInit
{

/// Stands for libKVnative among the packages. No other library can name it, since none is linked to it.
class native;

} // namespace KvInit

namespace Kv
{

template <> InInit<KvInit::native>::InInit() : InPackageInit("native")
{
    registerPackage();
    addDependency(InInit<KvInit::resmgt>::getType());
    addDependency(InInit<KvInit::base>::getType());
}

template <> void InInit<KvInit::native>::initPackage()
{
    InBuildInfoUtil::registerInfo(std::make_unique<InLibraryBuildInfo>("libKVnative", __DATE__));
}

namespace
{

InInit<KvInit::native> const record;

} // namespace

} // namespace Kv
