#include "packages/inBuildInfo.h"

#include <utility>

namespace Kv
{

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

} // namespace Kv
