#include "buildInfo.h"

#include "packages/inBuildInfo.h"

#include <iomanip>

namespace Velmora
{

void writeBuildInfo(std::ostream& stream)
{
    constexpr int packageWidth = 14;
    constexpr int libraryWidth = 18;
    for (Kv::InPackageInfo const& package : Kv::InBuildInfoUtil::getInfos())
    {
        stream << std::left << std::setw(packageWidth) << package.packageName;
        if (Kv::InBuildInfo const* const info = package.buildInfo)
            stream << std::setw(libraryWidth) << info->getLibraryName() << info->getProductName() << ' '
                   << info->getVersionString() << info->getVersionSuffix() << " (" << info->getReleaseYear()
                   << "), build " << info->getBuildNumber() << " of " << info->getBuildDate() << ", "
                   << info->getBuildFlavour();
        stream << '\n';
    }
}

} // namespace Velmora
