#include "base/inPackageInitBase.h"

namespace Kv
{

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

} // namespace Kv
