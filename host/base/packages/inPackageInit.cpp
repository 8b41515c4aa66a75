#include "packages/inPackageInit.h"

#include <algorithm>
#include <mutex>
#include <utility>

namespace Kv
{

namespace
{

/// The packages of the process.
struct Packages
{
    // A library that comes later needs no memory for its place here.
    Packages() { loaded.reserve(64); }

    /// By the places where they are announced: a package that is loaded from two files stands here twice.
    std::vector<InPackageInit*> loaded;
    /// Those that are set up, in that order.
    std::vector<InPackageInit*> ready;
    InPackageInit* current = nullptr;
    /// Setting a package up leads back here.
    std::recursive_mutex mutex;
};

Packages& getAll()
{
    static Packages packages;
    return packages;
}

template <typename Item> void remove(std::vector<Item*>& items, Item const* item)
{
    items.erase(std::remove(items.begin(), items.end(), item), items.end());
}

template <typename Items, typename Item> bool contains(Items const& items, Item const* item)
{
    return std::find(items.begin(), items.end(), item) != items.end();
}

/// Makes a package the current one for as long as this lives.
class Current
{
public:
    explicit Current(InPackageInit* package) : _before(std::exchange(getAll().current, package)) {}
    Current(Current const&) = delete;
    Current& operator=(Current const&) = delete;
    ~Current() { getAll().current = _before; }

private:
    InPackageInit* _before;
};

} // namespace

InVariableBase::InVariableBase() = default;

InVariableBase::~InVariableBase() = default;

void InVariableBase::addDependency(InVariableBase* other)
{
    if (!contains(_dependencies, other))
        _dependencies.push_back(other);
}

void InVariableBase::removeDependency(InVariableBase* other)
{
    remove(_dependencies, other);
}

InPackageInitBase::InPackageInitBase(char const* name) : _name(name) {}

InPackageInitBase::~InPackageInitBase() = default;

char const* InPackageInitBase::getName() const
{
    return _name.c_str();
}

void InPackageInitBase::prepareInit() {}

void InPackageInitBase::prepareFinish() {}

void InPackageInitBase::finishPackage() {}

void InPackageInitBase::setInitialized(bool initialized)
{
    _initialized = initialized;
}

InPackageInit::InPackageInit(char const* name) : InPackageInitBase(name) {}

InPackageInit::~InPackageInit()
{
    Packages& all = getAll();
    std::lock_guard const lock(all.mutex);
    remove(all.loaded, this);
    remove(all.ready, this);
    for (InPackageInit* const other : all.loaded)
        other->removeDependency(this);
}

void InPackageInit::registerPackage()
{
    Packages& all = getAll();
    std::lock_guard const lock(all.mutex);
    _type = &typeid(*this);
    all.loaded.push_back(this);
}

void InPackageInit::addDependency(std::type_info const* package)
{
    _dependencyTypes.at(_dependencyCount) = package;
    ++_dependencyCount;
}

std::vector<InPackageInit const*> InPackageInit::getPackages()
{
    Packages& all = getAll();
    std::lock_guard const lock(all.mutex);
    for (InPackageInit* const package : std::vector(all.loaded))
        package->setUp();
    return {all.ready.begin(), all.ready.end()};
}

InPackageInit* InPackageInit::getCurrent()
{
    Packages& all = getAll();
    std::lock_guard const lock(all.mutex);
    return all.current;
}

void InPackageInit::setBuildInfo(OPtr<InBuildInfo> info)
{
    _buildInfo = std::move(info);
}

void InPackageInit::setUp()
{
    if (isInitialized())
        return;
    // First of all, so that a ring of dependencies ends here.
    setInitialized(true);
    for (std::size_t i = 0; i < _dependencyCount; ++i)
        for (InPackageInit* const other : getAll().loaded)
            if (*other->_type == *_dependencyTypes[i])
                addDependency(other);
    for (InVariableBase* const dependency : std::vector(getDependencies()))
        if (auto* const other = dynamic_cast<InPackageInit*>(dependency))
            other->setUp();
    getAll().ready.push_back(this);
    Current const current(this);
    initPackage();
}

} // namespace Kv
