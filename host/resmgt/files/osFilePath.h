#pragma once

#include "kvExport.h"

#include <filesystem>
#include <string>

namespace Kv
{

/// Path of a file: a list of components, of which a default path and one made from the empty string have none.
class KV_API OsFilePath
{
public:
    OsFilePath();
    OsFilePath(OsFilePath const&);
    OsFilePath(OsFilePath&&) noexcept;
    OsFilePath& operator=(OsFilePath const&);
    OsFilePath& operator=(OsFilePath&&) noexcept;
    ~OsFilePath();

    /// Keeps the path as it is given. Throws `ExBase` for one with a zero byte, behind which the system would not look.
    explicit OsFilePath(std::string const& path);

    /// The path as given, ended by a zero byte; borrowed, valid while the path lives unchanged.
    char const* getChars() const;

    std::string toString() const;

    /// True for a path without components.
    bool isEmpty() const;

    /// The absolute path of what the system finds under this one: symbolic links are followed, and "." and ".." taken
    /// out. What comes behind the last component that exists stays as it is. Throws `ExBase` where a relative path
    /// stands in a folder that is no longer there.
    OsFilePath getCanonical() const;

    /// The folder that holds what the path names; that of "name" alone is ".".
    OsFilePath getFolder() const;

    /// The last component.
    std::string getFileName() const;

    friend bool operator==(OsFilePath const& a, OsFilePath const& b) { return a._path == b._path; }
    friend bool operator!=(OsFilePath const& a, OsFilePath const& b) { return !(a == b); }

private:
    std::filesystem::path _path;
};

} // namespace Kv
