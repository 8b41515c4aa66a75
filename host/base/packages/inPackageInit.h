#pragma once

#include "packages/inBuildInfo.h"
#include "pointers/plainPtr.h"

#include <array>
#include <cstddef>
#include <string>
#include <typeinfo>
#include <vector>

namespace Kv
{

/// A thing that is set up in an order: knows what must be ready before it. Borrows what it depends on.
class KV_API InVariableBase
{
public:
    InVariableBase();
    InVariableBase(InVariableBase const&) = delete;
    InVariableBase& operator=(InVariableBase const&) = delete;
    virtual ~InVariableBase();

    /// Has `other` set up first. Once is enough.
    virtual void addDependency(InVariableBase* other);

    /// Takes back `addDependency`, as before `other` goes.
    virtual void removeDependency(InVariableBase* other);

    /// Name for people, valid as long as this lives.
    virtual char const* getName() const = 0;

    std::vector<InVariableBase*> const& getDependencies() const { return _dependencies; }

private:
    std::vector<InVariableBase*> _dependencies;
};

/// The operations of a package, in the order that libraries are built against. The package system calls `initPackage`
/// and `setInitialized` alone.
class KV_API InPackageInitBase : public InVariableBase
{
public:
    explicit InPackageInitBase(char const* name);
    ~InPackageInitBase() override;

    char const* getName() const override;
    virtual void prepareInit();
    virtual void prepareFinish();

    /// Sets the package up; called once, after those that it depends on.
    virtual void initPackage() = 0;

    virtual void finishPackage();

    /// Tells the package that it is set up, before it is.
    virtual void setInitialized(bool initialized);
    bool isInitialized() const { return _initialized; }

private:
    std::string _name;
    bool _initialized = false;
};

/// Record of a package: one static object of the library, which announces it while the library loads and takes it back
/// when it is unloaded. Packages name each other by the types of their records. Libraries can be loaded on any thread.
class KV_API InPackageInit : public InPackageInitBase
{
public:
    explicit InPackageInit(char const* name);
    ~InPackageInit() override;

    /// Announces the package. To be called by the constructor of the record's own class, whose type it takes.
    void registerPackage();

    using InPackageInitBase::addDependency;

    /// Has the package with a record of that type set up first, if it is loaded by then. There can be 16 of them; one
    /// more throws `std::out_of_range`.
    void addDependency(std::type_info const* package);

    /// Every package that is loaded, in the order in which they were set up; sets those up first that are not yet.
    static std::vector<InPackageInit const*> getPackages();

    /// The package whose `initPackage` is running, or null.
    static InPackageInit* getCurrent();

    /// Null while there is none.
    InBuildInfo* getBuildInfo() const { return _buildInfo.get(); }

    /// Takes the place of the one before.
    void setBuildInfo(OPtr<InBuildInfo> info);

private:
    void setUp();

    std::type_info const* _type = nullptr;
    // Of a size that is known: what a library does while it is loaded must not need memory.
    std::array<std::type_info const*, 16> _dependencyTypes{};
    std::size_t _dependencyCount = 0;
    OPtr<InBuildInfo> _buildInfo;
};

} // namespace Kv
