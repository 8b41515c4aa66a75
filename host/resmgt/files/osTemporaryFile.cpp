#include "files/osTemporaryFile.h"

#include <array>
#include <cerrno>
#include <climits>
#include <cstdio>
#include <fcntl.h>
#include <string_view>
#include <system_error>
#include <unistd.h>
#include <utility>

namespace Kv
{

namespace
{

void require(bool success)
{
    if (!success)
        throw std::system_error(errno, std::generic_category());
}

/// Files are known as left on the machine that made them alone: what another one has locked is not seen here on every
/// file system.
std::string getMachineName()
{
    std::array<char, HOST_NAME_MAX + 1> name{};
    require(::gethostname(name.data(), name.size()) == 0);
    return name.data();
}

/// Removes a file whose process has been killed.
void removeLeft(std::string const& path)
{
    OsFileDescriptor const file(::open(path.c_str(), O_WRONLY | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC));
    if (file.isOpen() && file.lock() && file.isFileAt(path))
        ::unlink(path.c_str());
}

} // namespace

OsTemporaryFile::OsTemporaryFile(OsFilePath const& folder, mode_t permissions)
    : _path(folder.toString() + "/.saving-" + getMachineName() + "-"), _descriptor(create(_path, permissions))
{
    require(_descriptor.isOpen());
}

OsTemporaryFile::~OsTemporaryFile()
{
    if (!_path.empty())
        ::unlink(_path.c_str());
}

void OsTemporaryFile::write(std::string const& content)
{
    std::string_view rest = content;
    while (!rest.empty())
    {
        ssize_t const count = ::write(_descriptor.get(), rest.data(), rest.size());
        require(count >= 0 || errno == EINTR);
        if (count > 0)
            rest.remove_prefix(static_cast<std::size_t>(count));
    }
}

void OsTemporaryFile::takeOwnerAndPermissions(struct stat const& other)
{
    // A change of the owner takes permissions away: it comes first. Where it is refused, the group alone may do.
    if (::fchown(_descriptor.get(), other.st_uid, other.st_gid) != 0)
        static_cast<void>(::fchown(_descriptor.get(), static_cast<uid_t>(-1), other.st_gid));
    constexpr mode_t allPermissions = 07777;
    require(::fchmod(_descriptor.get(), other.st_mode & allPermissions) == 0);
}

struct stat OsTemporaryFile::sync()
{
    struct stat status = {};
    require(::fsync(_descriptor.get()) == 0 && ::fstat(_descriptor.get(), &status) == 0);
    return status;
}

OsFileDescriptor OsTemporaryFile::moveTo(OsFilePath const& target)
{
    OsFileDescriptor const folder(::open(target.getFolder().getChars(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    require(std::rename(_path.c_str(), target.getChars()) == 0);
    _path.clear();
    // Without it a power cut can bring the old file back. It is whole then too: no reason to fail where a folder cannot
    // be read or put on the disk.
    if (folder.isOpen())
        static_cast<void>(::fsync(folder.get()));
    return std::move(_descriptor);
}

/// Adds to `path` what makes it the path of a file that was not there. Not open where the system refuses; no file is
/// left then.
OsFileDescriptor OsTemporaryFile::create(std::string& path, mode_t permissions)
{
    std::string const begin = std::move(path);
    for (int number = 0;; ++number)
    {
        path = begin + std::to_string(number);
        removeLeft(path);
        OsFileDescriptor file(::open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, permissions));
        if (!file.isOpen() && errno != EEXIST)
            return file;
        if (!file.isOpen())
            continue;
        try
        {
            // Before it was locked, another process may have held it for one that was left. Where nothing can be
            // locked, nothing is held for that.
            bool const isHeld = file.lock() || errno != EWOULDBLOCK;
            if (isHeld && file.isFileAt(path))
                return file;
        }
        catch (std::system_error const&)
        {
            ::unlink(path.c_str());
            throw;
        }
    }
}

} // namespace Kv
