#include "files/osLockedFile.h"

#include "files/osPlace.h"
#include "files/osTemporaryFile.h"

#include <cerrno>
#include <cstdio>
#include <fcntl.h>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>
#include <utility>

namespace Kv
{

namespace
{

constexpr mode_t forUserAlone = S_IRUSR | S_IWUSR;

void require(bool success)
{
    if (!success)
        throw std::system_error(errno, std::generic_category());
}

} // namespace

OsLockedFile OsLockedFile::create(OsFilePath const& folder, std::string const& begin, std::string const& end)
{
    for (int number = 1;; ++number)
    {
        std::string name = begin;
        name.append(std::to_string(number)).append(end);
        OsFilePath const path(OsPlace::join(folder.toString(), name));
        OsFileDescriptor file(::open(path.getChars(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, forUserAlone));
        require(file.isOpen() || errno == EEXIST);
        if (!file.isOpen())
            continue;
        try
        {
            // Another process can have taken it before it was locked.
            bool const isLocked = file.lock();
            require(isLocked || errno == EWOULDBLOCK);
            if (isLocked && file.isFileAt(path.toString()))
                return {path, std::move(file)};
        }
        catch (std::system_error const&)
        {
            ::unlink(path.getChars());
            throw;
        }
    }
}

std::optional<OsLockedFile> OsLockedFile::take(OsFilePath const& path)
{
    OsFileDescriptor file(::open(path.getChars(), O_RDWR | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC));
    if (file.isOpen() && file.lock() && file.isFileAt(path.toString()))
        return OsLockedFile(path, std::move(file));
    return std::nullopt;
}

OsLockedFile::OsLockedFile(OsFilePath path, OsFileDescriptor descriptor)
    : _path(std::move(path)), _descriptor(std::move(descriptor))
{
}

std::time_t OsLockedFile::getTime() const
{
    struct stat status = {};
    require(::fstat(_descriptor.get(), &status) == 0);
    return status.st_mtim.tv_sec;
}

void OsLockedFile::replace(std::string const& content)
{
    OsTemporaryFile file(_path.getFolder(), forUserAlone);
    file.write(content);
    file.sync();
    _descriptor = file.moveTo(_path);
}

void OsLockedFile::move(OsFilePath const& path)
{
    require(std::rename(_path.getChars(), path.getChars()) == 0);
    _path = path;
}

void OsLockedFile::remove() noexcept
{
    ::unlink(_path.getChars());
}

} // namespace Kv
