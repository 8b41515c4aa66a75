#include "packages/inBuildInfo.h"

#include "packages/inPackageInit.h"
#include "pointers/rcExUtil.h"

#include <atomic>
#include <utility>

namespace Kv
{

namespace
{

std::atomic<ApplicationModes> applicationMode{ApplicationModes::NonInteractive};

} // namespace

InBuildInfo::InBuildInfo() = default;

InBuildInfo::~InBuildInfo() = default;

InLibraryBuildInfo::InLibraryBuildInfo(std::string libraryName, char const* buildDate)
    : _libraryName(std::move(libraryName)), _buildDate(buildDate)
{
}

char const* InLibraryBuildInfo::getBuildFlavour() const
{
    return KV_BUILD_FLAVOUR;
}

InBuildInfo& InBuildInfoUtil::registerInfo(OPtr<InBuildInfo> info)
{
    if (!info)
        RCExUtil::throwExNullPtr(typeid(InBuildInfo*).name());
    InPackageInit* const package = InPackageInit::getCurrent();
    if (!package)
        throw ExBase(__FILE__, __LINE__, "Build information can be registered only while its package is set up");
    package->setBuildInfo(std::move(info));
    return *package->getBuildInfo();
}

std::vector<InPackageInfo> InBuildInfoUtil::getInfos()
{
    std::vector<InPackageInfo> infos;
    for (InPackageInit const* const package : InPackageInit::getPackages())
        infos.push_back({package->getName(), package->getBuildInfo()});
    return infos;
}

ApplicationModes InBuildInfoUtil::getApplicationMode()
{
    return applicationMode;
}

void InBuildInfoUtil::setApplicationMode(ApplicationModes mode)
{
    applicationMode = mode;
}

} // namespace Kv
