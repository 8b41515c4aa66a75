#include "pygraph/inPyextGraph.h"

#include "base/inBase.h"
#include "base/inBuildInfoUtil.h"
#include "base/inLibraryBuildInfo.h"

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
