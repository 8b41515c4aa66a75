#include "base/inPackageInit.h"

#include "base/inPackageRegistry.h"

namespace Kv
{

InPackageInit::InPackageInit(char const* name) : InPackageInitBase(name) {}

InPackageInit::~InPackageInit()
{
    InPackageRegistry::getInstance().remove(*this);
}

void InPackageInit::registerPackage()
{
    _type = &typeid(*this);
    InPackageRegistry::getInstance().add(*this);
}

void InPackageInit::addDependency(std::type_info const* package)
{
    _dependencyTypes.push_back(package);
}

} // namespace Kv
