#include "files/osFile.h"

#include "exBase.h"
#include "files/osAsync.h"
#include "files/osTemporaryFile.h"
#include "text/liString.h"

#include <array>
#include <cerrno>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>
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

[[noreturn]] void fail(char const* action, OsFilePath const& path, std::string const& words)
{
    throw ExBase(__FILE__, __LINE__,
                 std::string("Cannot ") + action + " " + LiStringUtil::getPrintablePath(path.toString()) + ": " +
                     words);
}

std::string getSystemWords()
{
    return std::generic_category().message(errno);
}

/// Nothing with `errno` where the path leads to nothing, or that cannot be told.
std::optional<struct stat> findStatus(OsFilePath const& path)
{
    struct stat status = {};
    if (stat(path.getChars(), &status) == 0)
        return status;
    return std::nullopt;
}

/// True for an `errno` that says so.
bool isNothingThere(int error)
{
    return error == ENOENT || error == ENOTDIR;
}

OsFile::Version toVersion(struct stat const& status)
{
    // Not the number of the device, which can be another one when the same disk is mounted the next time.
    return {static_cast<long long>(status.st_ino), static_cast<long long>(status.st_size),
            static_cast<long long>(status.st_mtim.tv_sec), static_cast<long long>(status.st_mtim.tv_nsec)};
}

bool canBeWritten(OsFilePath const& path, struct stat const& status)
{
    constexpr mode_t anyWriteBit = S_IWUSR | S_IWGRP | S_IWOTH;
    return (status.st_mode & anyWriteBit) != 0 && faccessat(AT_FDCWD, path.getChars(), W_OK, AT_EACCESS) == 0;
}

char const* getNoFileWords(struct stat const& status)
{
    return S_ISDIR(status.st_mode) ? "it is a folder" : "it is no regular file";
}

/// The obstacle to writing a file, in words; nothing where there is none. `status` is that of the file, if there is
/// one.
std::optional<std::string> findObstacle(OsFilePath const& path, std::optional<struct stat> const& status)
{
    OsFilePath const folder = path.getFolder();
    auto const folderStatus = findStatus(folder);
    if (!folderStatus)
        return "its folder cannot be found: " + getSystemWords();
    if (!canBeWritten(folder, *folderStatus))
        return "its folder cannot be written";
    if (status && !S_ISREG(status->st_mode))
        return getNoFileWords(*status);
    if (status && !canBeWritten(path, *status))
        return "its permissions do not allow it";
    return std::nullopt;
}

} // namespace

OsFile::FileDescriptorManipGuard::FileDescriptorManipGuard() : _lock(getDescriptorMutex()) {}

OsFile::FileDescriptorManipGuard::~FileDescriptorManipGuard() = default;

OsFile::OsFile(OsFilePath path) : _path(std::move(path)) {}

OsFile::~OsFile() = default;

std::uint64_t OsFile::getSize() const
{
    std::error_code error;
    std::uint64_t const size = std::filesystem::file_size(_path.toString(), error);
    if (error)
        throw ExBase(__FILE__, __LINE__,
                     "Cannot tell the size of " + LiStringUtil::getPrintablePath(_path.toString()) + ": " +
                         error.message());
    return size;
}

std::string OsFile::read(std::uint64_t maxSize) const
{
    // A pipe that nobody writes to would never be open otherwise.
    OsFileDescriptor const file(open(_path.getChars(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    struct stat status = {};
    if (!file.isOpen() || fstat(file.get(), &status) != 0)
        fail("read", _path, getSystemWords());
    if (!S_ISREG(status.st_mode))
        fail("read", _path, getNoFileWords(status));
    if (static_cast<std::uint64_t>(status.st_size) > maxSize)
        fail("read", _path, "it is larger than " + std::to_string(maxSize) + " bytes");
    std::string content;
    std::array<char, 1 << 16> buffer{};
    for (;;)
    {
        ssize_t const count = ::read(file.get(), buffer.data(), buffer.size());
        if (count == 0)
            return content;
        if (count > 0)
            content.append(buffer.data(), static_cast<std::size_t>(count));
        else if (errno != EINTR)
            fail("read", _path, getSystemWords());
    }
}

OsFile::Version OsFile::getVersion() const
{
    std::optional<struct stat> const status = findStatus(_path);
    if (!status && !isNothingThere(errno))
        fail("read", _path, getSystemWords());
    return status && S_ISREG(status->st_mode) ? toVersion(*status) : Version{};
}

bool OsFile::isWritable() const
{
    try
    {
        OsFilePath const target = _path.getCanonical();
        return !findObstacle(target, findStatus(target));
    }
    catch (ExBase const&)
    {
        return false;
    }
}

OsFile::Version OsFile::replace(std::string const& content) const
{
    OsFilePath const target = _path.getCanonical();
    auto const old = findStatus(target);
    int const reason = errno;
    if (auto const obstacle = findObstacle(target, old))
        fail("write", target, *obstacle);
    if (!old && !isNothingThere(reason))
        fail("write", target, std::generic_category().message(reason));
    try
    {
        OsTemporaryFile file(target.getFolder());
        file.write(content);
        if (old)
            file.takeOwnerAndPermissions(*old);
        Version const version = toVersion(file.sync());
        file.moveTo(target);
        return version;
    }
    catch (std::system_error const& error)
    {
        fail("write", target, error.code().message());
    }
}

bool OsFileDescriptor::lock() const
{
    return ::flock(_descriptor, LOCK_EX | LOCK_NB) == 0;
}

bool OsFileDescriptor::isFileAt(std::string const& path) const
{
    struct stat own = {};
    struct stat found = {};
    if (::fstat(_descriptor, &own) == 0 && ::lstat(path.c_str(), &found) == 0)
        return own.st_dev == found.st_dev && own.st_ino == found.st_ino;
    if (isNothingThere(errno))
        return false;
    throw std::system_error(errno, std::generic_category());
}

bool OsFsUtils::fileExists(OsFilePath const& path)
{
    auto const kind = findKind(path);
    return !kind || std::filesystem::exists(std::filesystem::file_status(*kind));
}

std::optional<std::filesystem::file_type> OsFsUtils::findKind(OsFilePath const& path)
{
    auto const look = [file = path.toString()]
    {
        std::error_code error;
        return std::filesystem::status(file, error).type();
    };
    return OsAsync::ask(path.toString(), look);
}

} // namespace Kv
