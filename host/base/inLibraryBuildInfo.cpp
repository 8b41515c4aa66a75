#include "base/inLibraryBuildInfo.h"

namespace Kv
{

InLibraryBuildInfo::InLibraryBuildInfo(char const* libraryName, char const* buildDate)
    : _libraryName(libraryName), _buildDate(buildDate)
{
}

InLibraryBuildInfo::~InLibraryBuildInfo() = default;

char const* InLibraryBuildInfo::getProductName() const
{
    return "Quorvane Velmora Library";
}

char const* InLibraryBuildInfo::getLibraryName() const
{
    return _libraryName.c_str();
}

char const* InLibraryBuildInfo::getReleaseYear() const
{
    return "2013";
}

char const* InLibraryBuildInfo::getVersionString() const
{
    return "8.0";
}

char const* InLibraryBuildInfo::getVersionSuffix() const
{
    return getReleaseStage() == 3 ? "dev" : "";
}

int InLibraryBuildInfo::getMajorVersion() const
{
    return 8;
}

int InLibraryBuildInfo::getMinorVersion() const
{
    return 0;
}

int InLibraryBuildInfo::getReleaseStage() const
{
    return 42;
}

char const* InLibraryBuildInfo::getBuildNumber() const
{
    return "2600";
}

char const* InLibraryBuildInfo::getBuildDate() const
{
    return _buildDate.c_str();
}

char const* InLibraryBuildInfo::getBuildFlavour() const
{
    return KV_BUILD_FLAVOUR;
}

} // namespace Kv
