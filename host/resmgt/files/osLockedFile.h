#pragma once

#include "files/osFile.h"
#include "files/osFilePath.h"
#include "kvExport.h"

#include <ctime>
#include <optional>
#include <string>

namespace Kv
{

/// A file that belongs to this process: none can take it for as long as the object lives, and any when the process has
/// ended, in whatever way. The user alone can read it. Operations throw `std::system_error` where the system refuses
/// them.
class KV_API OsLockedFile
{
public:
    /// Makes an empty file whose name is `begin`, a number and `end`.
    static OsLockedFile create(OsFilePath const& folder, std::string const& begin, std::string const& end);

    /// Takes a file that is there. Nothing where there is none, or it belongs to another process or to another object.
    static std::optional<OsLockedFile> take(OsFilePath const& path);

    OsFilePath const& getPath() const { return _path; }

    /// When the content was written last.
    std::time_t getTime() const;

    /// Makes `content` the whole content, at once or not at all. The file belongs to the process all along.
    void replace(std::string const& content);

    /// Puts it under another name in the same file system, in the place of what is there.
    void move(OsFilePath const& path);

    /// Without a word where it cannot be removed.
    void remove() noexcept;

private:
    OsLockedFile(OsFilePath path, OsFileDescriptor descriptor);

    OsFilePath _path;
    OsFileDescriptor _descriptor;
};

} // namespace Kv
