#pragma once

#include "base/inVariableBase.h"

#include <string>

namespace Kv
{

/// The life of a package, as it is told of it. Packages that are loaded together are set up together, each after those
/// that it depends on, and all are taken down in the opposite order when the process ends.
class KV_API InPackageInitBase : public InVariableBase
{
public:
    explicit InPackageInitBase(char const* name);
    ~InPackageInitBase() override;

    char const* getName() const override;

    /// Comes before the first package of those loaded together is set up.
    virtual void prepareInit();

    /// Comes before the first package of all is taken down.
    virtual void prepareFinish();

    /// Sets the package up; called once.
    virtual void initPackage() = 0;

    /// Takes the package down. Not called for a library that is unloaded earlier.
    virtual void finishPackage();

    /// Tells the package that it is set up, before it is, or taken down.
    virtual void setInitialized(bool initialized);
    bool isInitialized() const { return _initialized; }

private:
    std::string _name;
    bool _initialized = false;
};

} // namespace Kv
