#include "wsNative.h"

#include "files/osFile.h"
#include "wsCursorRegistry.h"
#include "wsThread.h"

#include <dlfcn.h>
#include <fcntl.h>
#include <filesystem>
#include <vector>

namespace Kv
{

namespace
{

NtPlatform* loadedPlatform = nullptr;
NtScriptHook* scriptHook = nullptr;

std::filesystem::path nativeLibraryPath()
{
    Dl_info info{};
    dladdr(&loadedPlatform, &info);
    return std::filesystem::path(info.dli_fname).replace_filename("libKVnative.so");
}

/// Where Qt starts without a handle that it needs, it ends the process, or is left without fonts. The number is several
/// times what it uses.
void requireHandles()
{
    constexpr std::size_t needed = 24;
    std::vector<OsFileDescriptor> handles;
    while (handles.size() < needed)
    {
        handles.emplace_back(open("/", O_PATH | O_CLOEXEC));
        if (!handles.back().isOpen())
            throw ExBase(__FILE__, __LINE__,
                         "Cannot load the window system: there are too few file handles left; close files first");
    }
}

NtPlatform& loadPlatform()
{
    requireHandles();
    std::filesystem::path const path = nativeLibraryPath();
    void* const library = dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL);
    void* const entry = library ? dlsym(library, ntPlatformEntry) : nullptr;
    if (!entry)
        throw ExBase(__FILE__, __LINE__, std::string("Cannot load the window system: ") + dlerror());
    return reinterpret_cast<NtPlatformEntry>(entry)();
}

} // namespace

NtPlatform& WsNative::getPlatform()
{
    WsThread::require("Window system");
    if (!loadedPlatform)
    {
        loadedPlatform = &loadPlatform();
        loadedPlatform->setScriptHook(scriptHook);
        WsCursorRegistry::getInstance().apply();
    }
    return *loadedPlatform;
}

NtPlatform* WsNative::getLoadedPlatform()
{
    return loadedPlatform;
}

void WsNative::setScriptHook(NtScriptHook* hook)
{
    scriptHook = hook;
    if (loadedPlatform)
        loadedPlatform->setScriptHook(hook);
}

} // namespace Kv
