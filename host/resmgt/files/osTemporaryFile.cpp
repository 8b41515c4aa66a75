#include "files/osTemporaryFile.h"

#include <cerrno>
#include <cstdio>
#include <fcntl.h>
#include <string_view>
#include <system_error>
#include <unistd.h>

namespace Kv
{

namespace
{

void require(bool success)
{
    if (!success)
        throw std::system_error(errno, std::generic_category());
}

} // namespace

OsTemporaryFile::OsTemporaryFile(OsFilePath const& folder)
    : _path(folder.toString() + "/.saving-" + std::to_string(getpid())), _descriptor(create(_path))
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

void OsTemporaryFile::moveTo(OsFilePath const& target)
{
    require(::fsync(_descriptor.get()) == 0);
    require(std::rename(_path.c_str(), target.getChars()) == 0);
    _path.clear();
}

/// Adds to `path` what makes it the path of a file that was not there. Negative where the system refuses; no file is
/// left then.
int OsTemporaryFile::create(std::string& path)
{
    std::string const begin = std::move(path);
    constexpr mode_t newFile = S_IRUSR | S_IWUSR | S_IRGRP | S_IWGRP | S_IROTH | S_IWOTH;
    for (int number = 0;; ++number)
    {
        path = begin + "-" + std::to_string(number);
        int const descriptor = ::open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, newFile);
        if (descriptor >= 0 || errno != EEXIST)
            return descriptor;
    }
}

} // namespace Kv
