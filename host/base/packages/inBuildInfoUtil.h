#pragma once

#include "packages/inBuildInfo.h"
#include "pointers/oPtr.h"

#include <vector>

namespace Kv
{

/// What a process is.
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

/// What is known of the process and of the packages that it is made of.
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
