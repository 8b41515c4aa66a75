#pragma once

#include "files/osFilePath.h"
#include "kvExport.h"

#include <array>
#include <cstdint>
#include <filesystem>
#include <mutex>
#include <optional>
#include <string>
#include <unistd.h>
#include <utility>

namespace Kv
{

/// A file of the system, by its path; the file need not exist.
class KV_API OsFile
{
public:
    /// While one lives, no other thread that uses the guard opens or closes a descriptor. Who forks takes it too, so
    /// that the child inherits no descriptor that is half set up. One thread may hold several.
    class KV_API FileDescriptorManipGuard
    {
    public:
        FileDescriptorManipGuard();
        FileDescriptorManipGuard(FileDescriptorManipGuard const&) = delete;
        FileDescriptorManipGuard& operator=(FileDescriptorManipGuard const&) = delete;
        ~FileDescriptorManipGuard();

    private:
        std::lock_guard<std::recursive_mutex> _lock;
    };

    explicit OsFile(OsFilePath path);
    OsFile(OsFile const&) = delete;
    OsFile& operator=(OsFile const&) = delete;
    ~OsFile();

    /// Size in bytes, asked of the system at each call. Throws `ExBase`, naming the path, where there is no file, or
    /// what is there is a directory or something else without a size.
    std::uint64_t getSize() const;

    /// The whole content. Throws `ExBase`, naming the path, where there is no regular file that can be read, and for
    /// one of more than `maxSize` bytes.
    std::string read(std::uint64_t maxSize) const;

    /// Tells whether a file has been written or replaced: is another one then.
    using Version = std::array<long long, 4>;

    /// All zero where there is no regular file. Throws `ExBase`, naming the path, where the system cannot tell.
    Version getVersion() const;

    /// True if `replace` would find what it needs: a regular file that can be written, or none, in a folder that can be
    /// written. A file that nobody may write, by its permissions, cannot be written by the superuser either.
    bool isWritable() const;

    /// Makes `content` the whole content of the file, at once or not at all: another process sees the old file or the
    /// new one, and so does whoever comes after a failure. Symbolic links are followed, and a file that is there keeps
    /// its permissions and, where the system allows it, its owner. Gives the file's version. Throws `ExBase`, naming
    /// the path, where it cannot be done.
    Version replace(std::string const& content) const;

private:
    OsFilePath _path;
};

/// Owns a descriptor of the system and closes it.
class KV_API OsFileDescriptor
{
public:
    /// A negative descriptor stands for none.
    explicit OsFileDescriptor(int descriptor) : _descriptor(descriptor) {}
    OsFileDescriptor(OsFileDescriptor&& other) noexcept : _descriptor(std::exchange(other._descriptor, -1)) {}
    OsFileDescriptor& operator=(OsFileDescriptor&& other) noexcept
    {
        std::swap(_descriptor, other._descriptor);
        return *this;
    }
    ~OsFileDescriptor()
    {
        if (isOpen())
            ::close(_descriptor);
    }

    bool isOpen() const { return _descriptor >= 0; }
    int get() const { return _descriptor; }

    /// Locks the file against others who lock it, until the descriptor is closed, if only by the end of the process.
    /// False with `errno` where that is refused; it is `EWOULDBLOCK` where another descriptor has the lock.
    bool lock() const;

    /// True if the path leads to the file of this descriptor, and not to one that has come into its place. Throws
    /// `std::system_error` where the system cannot tell.
    bool isFileAt(std::string const& path) const;

private:
    int _descriptor;
};

/// Questions to the file system.
class KV_API OsFsUtils
{
public:
    /// True for an existing file, directory or anything else that a path can lead to; false also where nobody may look.
    /// Where the file system does not answer in time, something can be there: true.
    static bool fileExists(OsFilePath const& path);

    /// The kind of what a path leads to, which can be nothing; no kind where the file system does not answer in time.
    static std::optional<std::filesystem::file_type> findKind(OsFilePath const& path);
};

} // namespace Kv
