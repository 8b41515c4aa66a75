#pragma once

#include "kvExport.h"

namespace Kv
{

/// The process as an application with windows.
class KV_API UiApplication
{
public:
    /// Borrowed; lives as long as the process.
    static UiApplication* getInstance();

    /// Dispatches events on this thread until `*until` is true, however it came to be, and returns. Loops nest. `*end`
    /// is set to true when the window is asked to close and has no button that stands for that. What a handler throws
    /// ends the loop and is thrown from here.
    void localMessageLoop(bool const volatile* until, bool volatile* end);
};

} // namespace Kv
