#pragma once

#include "base/inPackageInitBase.h"

#include <typeinfo>
#include <vector>

namespace Kv
{

/// Record of a package: one static object of the library, which announces it while the library loads and takes it back
/// when it is unloaded. Packages name each other by the types of their records.
class KV_API InPackageInit : public InPackageInitBase
{
public:
    explicit InPackageInit(char const* name);
    ~InPackageInit() override;

    /// Announces the package. To be called by the constructor of the record's own class, whose type it takes.
    void registerPackage();

    /// The type that others name; null before `registerPackage`.
    std::type_info const* getRegisteredType() const { return _type; }

    using InPackageInitBase::addDependency;

    /// Has the package with a record of that type set up first, if it is loaded by then.
    void addDependency(std::type_info const* package);

    std::vector<std::type_info const*> const& getDependencyTypes() const { return _dependencyTypes; }

private:
    std::type_info const* _type = nullptr;
    std::vector<std::type_info const*> _dependencyTypes;
};

} // namespace Kv
