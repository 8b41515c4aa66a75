#pragma once

#include "kvExport.h"
#include "ntPlatform.h"

namespace Kv
{

/// The way to the window system. Its library is loaded at the first need, so that a process which only makes
/// descriptions never pays for it.
class KV_API WsNative
{
public:
    /// The platform, loaded if it is not yet there. Throws an `ExBase` with words where it cannot be loaded, and on
    /// another thread than that of the user interface.
    static NtPlatform& getPlatform();

    /// The platform if something needed it already, else null.
    static NtPlatform* getLoadedPlatform();

    /// Installs the scripts' interpreter for the native loop, now or when the platform is loaded. Borrowed.
    static void setScriptHook(NtScriptHook* hook);
};

} // namespace Kv
