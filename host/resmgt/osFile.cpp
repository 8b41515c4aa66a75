#include "resmgt/osFile.h"

#include "base/exBase.h"
#include "resmgt/liStringUtil.h"

#include <system_error>
#include <utility>

namespace Kv
{

namespace
{

std::recursive_mutex& getDescriptorMutex()
{
    static std::recursive_mutex mutex;
    return mutex;
}

} // namespace

OsFile::FileDescriptorManipGuard::FileDescriptorManipGuard() : _lock(getDescriptorMutex()) {}

OsFile::FileDescriptorManipGuard::~FileDescriptorManipGuard() = default;

OsFile::OsFile(OsFilePath path) : _path(std::move(path)) {}

std::uint64_t OsFile::getSize() const
{
    std::error_code error;
    std::uint64_t const size = std::filesystem::file_size(_path.toString(), error);
    if (error)
        throw ExBase(__FILE__, __LINE__,
                     "Cannot tell the size of " + LiStringUtil::getPrintable(_path.toString()) + ": " +
                         error.message());
    return size;
}

} // namespace Kv
