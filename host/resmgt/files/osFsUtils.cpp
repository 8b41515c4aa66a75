#include "files/osFsUtils.h"

#include <filesystem>
#include <system_error>

namespace Kv
{

bool OsFsUtils::fileExists(OsFilePath const& path)
{
    std::error_code error;
    return std::filesystem::exists(path.toString(), error);
}

} // namespace Kv
