#pragma once

#include "packages/inPackageInit.h"

#include <typeinfo>

namespace Kv
{

/// Record of the package that the tag `Package` stands for.
template <typename Package> class InInit : public InPackageInit
{
public:
    /// Names the package, registers it and names those that it depends on.
    InInit();

    /// The type by which others depend on the package.
    static std::type_info const* getType();

    /// Registers the build information.
    void initPackage() override;

private:
    template <typename... Dependencies> void addDependencies()
    {
        (addDependency(InInit<Dependencies>::getType()), ...);
    }
};

} // namespace Kv

/// Declares the tag of a package, by which others depend on it.
#define KV_PACKAGE_TAG(name)                                                                                           \
    namespace KvInit                                                                                                   \
    {                                                                                                                  \
    class KV_API name;                                                                                                 \
    }                                                                                                                  \
    template <> KV_API std::type_info const* Kv::InInit<KvInit::name>::getType();

KV_PACKAGE_TAG(appUi)
KV_PACKAGE_TAG(base)
KV_PACKAGE_TAG(framework)
KV_PACKAGE_TAG(gfx)
KV_PACKAGE_TAG(inputDoor)
KV_PACKAGE_TAG(internalAPI)
KV_PACKAGE_TAG(pluginAPI)
KV_PACKAGE_TAG(pyextGraph)
KV_PACKAGE_TAG(pyextInit)
KV_PACKAGE_TAG(pyextTesting)
KV_PACKAGE_TAG(pyextUi)
KV_PACKAGE_TAG(resmgt)
KV_PACKAGE_TAG(scriptingAPI)
KV_PACKAGE_TAG(ui)

namespace KvInit
{

/// Exported by nobody: no library is linked to libKVnative.
class native;

} // namespace KvInit

#define KV_TEXT(word) #word

/// Makes the record of a package with the tags of those that it depends on, in namespace Kv. It is the first static
/// object of its library, which also defines its `initPackage`.
#define KV_PACKAGE(name, ...)                                                                                          \
    template <> void InInit<KvInit::name>::initPackage();                                                              \
    template <> std::type_info const* InInit<KvInit::name>::getType()                                                  \
    {                                                                                                                  \
        return &typeid(InInit);                                                                                        \
    }                                                                                                                  \
    template <> InInit<KvInit::name>::InInit() : InPackageInit(KV_TEXT(name))                                          \
    {                                                                                                                  \
        using namespace KvInit;                                                                                        \
        registerPackage();                                                                                             \
        addDependencies<__VA_ARGS__>();                                                                                \
    }                                                                                                                  \
    static InInit<KvInit::name> packageRecord __attribute__((init_priority(101)));
