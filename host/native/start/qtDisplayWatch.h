#pragma once

#include <string>

namespace Kv
{

/// Whether what Qt draws on is still there. Qt itself looks when it dispatches events, and then ends the process.
class QtDisplayWatch
{
public:
    /// From here on, for the application object that is there now. True where it is a new one.
    static bool watch();

    /// True in a process that was forked from the one that the windows belong to. It must not touch them.
    static bool isForked();

    /// The words for what has become of the display; empty where it is well.
    static std::string findLoss();

    /// Qt has found the connection to the display broken.
    static void noteBroken();
};

} // namespace Kv
