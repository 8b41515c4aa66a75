#pragma once

#include "kvExport.h"

namespace Kv
{

/// The one thread of the user interface: the first that asks for any of it.
class KV_API WsThread
{
public:
    /// Throws an `ExBase` with words when called on another thread than that of the user interface. `what` names what
    /// was asked for.
    static void require(char const* what);

    /// True on the thread of the user interface, and everywhere while there is none yet.
    static bool isCurrent();
};

} // namespace Kv
