#pragma once

#include "resmgt/kvResmgtExport.h"
#include "resmgt/osFilePath.h"

namespace Kv
{

/// Questions to the file system.
class KVRESMGT_API OsFsUtils
{
public:
    /// True for an existing file, directory or anything else that a path can lead to; false also where nobody may look.
    static bool fileExists(OsFilePath const& path);
};

} // namespace Kv
