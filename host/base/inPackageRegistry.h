#pragma once

#include "base/inBuildInfoUtil.h"
#include "base/inPackageInit.h"

#include <mutex>
#include <vector>

namespace Kv
{

/// The packages of the process and their build information. Libraries can be loaded on any thread, so every operation
/// can be called on any.
class InPackageRegistry
{
public:
    static InPackageRegistry& getInstance();

    /// Borrows the package until `remove`.
    void add(InPackageInit& package);

    /// Forgets the package and everything of it.
    void remove(InPackageInit& package);

    /// For the package that is being set up; throws an `ExBase` where none is.
    InBuildInfo& addInfo(OPtr<InBuildInfo> info);

    /// Every package in the order in which they have been set up; sets those up first that are not yet.
    std::vector<InPackageInfo> getInfos();

private:
    struct OwnedInfo
    {
        InPackageInit const* package;
        OPtr<InBuildInfo> info;
    };

    void initAll();
    void init(InPackageInit& package);
    void finishAll();

    /// Has each package depend on those that it names and that are loaded.
    void resolveDependencies();

    /// By the places where they are announced: a package that is loaded from two files stands here twice.
    std::vector<InPackageInit*> _packages;
    std::vector<InPackageInit*> _initialized;
    std::vector<OwnedInfo> _infos;
    InPackageInit const* _current = nullptr;

    /// Setting a package up leads back here.
    std::recursive_mutex _mutex;
};

} // namespace Kv
