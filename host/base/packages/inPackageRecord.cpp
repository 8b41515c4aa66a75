// The record of each library but the module, made of what the build says of it.
#include "packages/inBuildInfo.h"
#include "packages/inInit.h"

#include <memory>

namespace Kv
{

KV_PACKAGE(KV_PACKAGE_NAME, KV_PACKAGE_DEPENDENCIES)

template <> void InInit<KvInit::KV_PACKAGE_NAME>::initPackage()
{
    InBuildInfoUtil::registerInfo(std::make_unique<InLibraryBuildInfo>(std::string("libKV") + getName(), __DATE__));
}

} // namespace Kv
