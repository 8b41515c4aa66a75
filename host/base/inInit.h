#pragma once

#include "base/inPackageInit.h"

#include <typeinfo>

namespace Kv
{

/// Record of the package that the tag `Package` stands for. The library of the package specialises the three operations
/// and exports `getType`.
template <typename Package> class InInit : public InPackageInit
{
public:
    /// Names the package, registers it and names those that it depends on.
    InInit();

    /// The type by which others depend on the package.
    static std::type_info const* getType();

    /// Registers the build information.
    void initPackage() override;
};

} // namespace Kv
