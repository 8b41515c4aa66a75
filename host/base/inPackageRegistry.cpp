#include "base/inPackageRegistry.h"

#include "base/rcExUtil.h"

#include <algorithm>
#include <cstddef>
#include <cstdlib>
#include <iterator>
#include <utility>

namespace Kv
{

namespace
{

template <typename Item> void eraseItem(std::vector<Item*>& items, Item const* item)
{
    items.erase(std::remove(items.begin(), items.end(), item), items.end());
}

/// Puts a value in place for as long as it lives.
template <typename Value> class Scoped
{
public:
    Scoped(Value& place, Value value) : _place(place), _before(std::exchange(place, value)) {}
    Scoped(Scoped const&) = delete;
    Scoped& operator=(Scoped const&) = delete;
    ~Scoped() { _place = _before; }

private:
    Value& _place;
    Value _before;
};

} // namespace

InPackageRegistry& InPackageRegistry::getInstance()
{
    static InPackageRegistry instance;
    return instance;
}

void InPackageRegistry::add(InPackageInit& package)
{
    std::lock_guard const lock(_mutex);
    _packages.push_back(&package);
}

void InPackageRegistry::remove(InPackageInit& package)
{
    std::lock_guard const lock(_mutex);
    eraseItem(_packages, &package);
    eraseItem(_initialized, &package);
    for (InPackageInit* const other : _packages)
        other->removeDependency(&package);
    _infos.erase(std::remove_if(_infos.begin(), _infos.end(),
                                [&package](OwnedInfo const& owned) { return owned.package == &package; }),
                 _infos.end());
}

InBuildInfo& InPackageRegistry::addInfo(OPtr<InBuildInfo> info)
{
    std::lock_guard const lock(_mutex);
    if (!info)
        RCExUtil::throwExNullPtr(typeid(InBuildInfo*).name());
    if (!_current)
        throw ExBase(__FILE__, __LINE__, "Build information can be registered only while its package is set up");
    return *_infos.emplace_back(OwnedInfo{_current, std::move(info)}).info;
}

std::vector<InPackageInfo> InPackageRegistry::getInfos()
{
    std::lock_guard const lock(_mutex);
    initAll();
    std::vector<InPackageInfo> infos;
    for (InPackageInit const* const package : _initialized)
    {
        std::size_t const before = infos.size();
        for (OwnedInfo const& owned : _infos)
            if (owned.package == package)
                infos.push_back({package->getName(), owned.info.get()});
        if (infos.size() == before)
            infos.push_back({package->getName(), nullptr});
    }
    return infos;
}

void InPackageRegistry::initAll()
{
    std::vector<InPackageInit*> waiting;
    std::copy_if(_packages.begin(), _packages.end(), std::back_inserter(waiting),
                 [](InPackageInit const* package) { return !package->isInitialized(); });
    if (waiting.empty())
        return;
    // Behind the static objects of all libraries loaded so far, and so called before they go.
    static_cast<void>(std::atexit([] { getInstance().finishAll(); }));
    resolveDependencies();
    for (InPackageInit* const package : waiting)
        package->prepareInit();
    for (InPackageInit* const package : waiting)
        init(*package);
}

void InPackageRegistry::init(InPackageInit& package)
{
    if (package.isInitialized())
        return;
    // First of all, so that a ring of dependencies ends here.
    package.setInitialized(true);
    std::vector<InVariableBase*> const dependencies = package.getDependencies();
    for (InVariableBase* const dependency : dependencies)
        if (auto* const other = dynamic_cast<InPackageInit*>(dependency))
            init(*other);
    _initialized.push_back(&package);
    Scoped<InPackageInit const*> const current(_current, &package);
    package.initPackage();
}

void InPackageRegistry::finishAll()
{
    std::lock_guard const lock(_mutex);
    for (InPackageInit* const package : _initialized)
        package->prepareFinish();
    std::for_each(_initialized.rbegin(), _initialized.rend(),
                  [](InPackageInit* package)
                  {
                      package->finishPackage();
                      package->setInitialized(false);
                  });
    _initialized.clear();
    _infos.clear();
}

void InPackageRegistry::resolveDependencies()
{
    for (InPackageInit* const package : _packages)
        for (std::type_info const* const type : package->getDependencyTypes())
            for (InPackageInit* const other : _packages)
                if (*other->getRegisteredType() == *type)
                    package->addDependency(other);
}

} // namespace Kv
