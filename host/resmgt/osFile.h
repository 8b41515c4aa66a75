#pragma once

#include "resmgt/kvResmgtExport.h"
#include "resmgt/osFilePath.h"

#include <cstdint>
#include <mutex>

namespace Kv
{

/// A file of the system, by its path; the file need not exist.
class KVRESMGT_API OsFile
{
public:
    /// While one lives, no other thread that uses the guard opens or closes a descriptor. Who forks takes it too, so
    /// that the child inherits no descriptor that is half set up. One thread may hold several.
    class KVRESMGT_API FileDescriptorManipGuard
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

    /// Size in bytes, asked of the system at each call. Throws `ExBase`, naming the path, where there is no file, or
    /// what is there is a directory or something else without a size.
    std::uint64_t getSize() const;

private:
    OsFilePath _path;
};

} // namespace Kv
