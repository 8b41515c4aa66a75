#pragma once

#include "base/inBuildInfo.h"

#include <string>

namespace Kv
{

/// Build information of the libraries around the module, which all come from one build.
class KV_API InLibraryBuildInfo : public InBuildInfo
{
public:
    /// `buildDate` is `__DATE__` of the library.
    InLibraryBuildInfo(char const* libraryName, char const* buildDate);
    ~InLibraryBuildInfo() override;

    char const* getProductName() const override;
    char const* getLibraryName() const override;
    char const* getReleaseYear() const override;
    char const* getVersionString() const override;
    char const* getVersionSuffix() const override;
    int getMajorVersion() const override;
    int getMinorVersion() const override;
    int getReleaseStage() const override;
    char const* getBuildNumber() const override;
    char const* getBuildDate() const override;
    char const* getBuildFlavour() const override;

private:
    std::string _libraryName;
    std::string _buildDate;
};

} // namespace Kv
