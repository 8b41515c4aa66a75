#pragma once

#include "files/osFilePath.h"
#include "kvExport.h"

namespace Kv
{

/// Questions to the file system.
class KV_API OsFsUtils
{
public:
    /// True for an existing file, directory or anything else that a path can lead to; false also where nobody may look.
    static bool fileExists(OsFilePath const& path);
};

} // namespace Kv
