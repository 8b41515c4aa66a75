#pragma once

#include "kvExport.h"
#include "pointers/plainPtr.h"

#include <string>
#include <vector>

namespace Kv
{

/// The facts that a package gives about its build. The texts last as long as this.
class KV_API InBuildInfo
{
public:
    InBuildInfo();
    InBuildInfo(InBuildInfo const&) = delete;
    InBuildInfo& operator=(InBuildInfo const&) = delete;
    virtual ~InBuildInfo();

    virtual char const* getProductName() const = 0;
    virtual char const* getLibraryName() const = 0;
    virtual char const* getReleaseYear() const = 0;

    /// Major and minor version, joined by a dot; the suffix goes behind it.
    virtual char const* getVersionString() const = 0;
    virtual char const* getVersionSuffix() const = 0;
    virtual int getMajorVersion() const = 0;
    virtual int getMinorVersion() const = 0;

    /// The stage of the release; 3 is under development.
    virtual int getReleaseStage() const = 0;
    virtual char const* getBuildNumber() const = 0;

    /// As the compiler writes dates: "Feb 15 2012".
    virtual char const* getBuildDate() const = 0;

    /// Configuration, processor and compiler, joined by dots.
    virtual char const* getBuildFlavour() const = 0;
};

/// Build information of the libraries around the module, which all come from one build.
class KV_API InLibraryBuildInfo : public InBuildInfo
{
public:
    /// `buildDate` is `__DATE__` of the library.
    InLibraryBuildInfo(std::string libraryName, char const* buildDate);

    char const* getProductName() const override { return "Quorvane Velmora Library"; }
    char const* getLibraryName() const override { return _libraryName.c_str(); }
    char const* getReleaseYear() const override { return "2013"; }
    char const* getVersionString() const override { return "8.0"; }
    char const* getVersionSuffix() const override { return getReleaseStage() == 3 ? "dev" : ""; }
    int getMajorVersion() const override { return 8; }
    int getMinorVersion() const override { return 0; }
    int getReleaseStage() const override { return 42; }
    char const* getBuildNumber() const override { return "2600"; }
    char const* getBuildDate() const override { return _buildDate.c_str(); }
    char const* getBuildFlavour() const override;

private:
    std::string _libraryName;
    std::string _buildDate;
};

/// The kinds of processes.
enum class ApplicationModes
{
    Interactive = 0,
    /// Any process that is not the interactive application.
    NonInteractive = 1,
};

/// A package that is loaded, with its build information, which is null where it has registered none. Borrowed: valid as
/// long as the package is loaded.
struct InPackageInfo
{
    char const* packageName;
    InBuildInfo const* buildInfo;
};

/// The facts about the process and about the packages that it is made of.
class KV_API InBuildInfoUtil
{
public:
    /// Takes the build information of the package whose `initPackage` is running, and keeps it until the package is
    /// unloaded. Throws an `ExBase` at any other time, and `ExNullPtr` for none.
    static InBuildInfo& registerInfo(OPtr<InBuildInfo> info);

    /// Every package that is loaded, each behind those that it depends on. Sets those up first that are not yet.
    static std::vector<InPackageInfo> getInfos();

    /// `NonInteractive` unless the application has said otherwise.
    static ApplicationModes getApplicationMode();

    /// For the application itself, when it starts.
    static void setApplicationMode(ApplicationModes mode);
};

} // namespace Kv
