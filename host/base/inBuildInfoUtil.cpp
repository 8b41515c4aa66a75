#include "base/inBuildInfoUtil.h"

#include "base/inPackageRegistry.h"

#include <atomic>
#include <utility>

namespace Kv
{

namespace
{

std::atomic<ApplicationModes> applicationMode{ApplicationModes::NonInteractive};

} // namespace

InBuildInfo& InBuildInfoUtil::registerInfo(OPtr<InBuildInfo> info)
{
    return InPackageRegistry::getInstance().addInfo(std::move(info));
}

std::vector<InPackageInfo> InBuildInfoUtil::getInfos()
{
    return InPackageRegistry::getInstance().getInfos();
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
