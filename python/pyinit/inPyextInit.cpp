#include "pyinit/inPyextInit.h"

#include "base/inBase.h"
#include "base/inBuildInfoUtil.h"
#include "base/inLibraryBuildInfo.h"
#include "scriptingAPI/inScriptingApi.h"

#include <memory>

namespace Kv
{

template <> std::type_info const* InInit<KvInit::pyextInit>::getType()
{
    return &typeid(InInit);
}

template <> InInit<KvInit::pyextInit>::InInit() : InPackageInit("pyextInit")
{
    registerPackage();
    addDependency(InInit<KvInit::scriptingAPI>::getType());
    addDependency(InInit<KvInit::base>::getType());
}

template <> void InInit<KvInit::pyextInit>::initPackage()
{
    InBuildInfoUtil::registerInfo(std::make_unique<InLibraryBuildInfo>("libKVpyextInit", __DATE__));
}

namespace
{

InInit<KvInit::pyextInit> const record;

} // namespace

} // namespace Kv
