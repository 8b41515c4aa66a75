#pragma once

#include "kvExport.h"

#include <string>

namespace Kv
{

/// The place that a path leads to: a directory, or an entry in one. All are bytes of the file system.
struct KV_API OsPlace
{
    /// Absolute, without a slash at the end but for the root.
    std::string directory;
    /// Empty for the directory itself.
    std::string name;

    /// An absolute path, which nobody has looked at, of one that is relative to the directory `base`, or begins with
    /// the home directory as "~". An empty base is the current directory of the process.
    static std::string complete(std::string const& path, std::string const& base);

    /// `path` is absolute. Throws `ExBase`, with words that name it, where nothing is there.
    static OsPlace find(std::string const& path);

    /// The same for whoever cannot wait: where the file system does not answer in time, the path counts as that of a
    /// directory.
    static OsPlace findInTime(std::string const& path);

    /// The place of an entry that is not there yet. Throws `ExBase` where it is, or where its directory is not.
    static OsPlace findNew(std::string const& path);

    /// The directory, or where it is gone, the nearest one above it that exists.
    static std::string findNearest(std::string const& directory);

    /// The path of an entry; of the directory itself where the name is empty.
    static std::string join(std::string const& directory, std::string const& name);

    /// A path within words for a person: in quotes, and whole however long, since it is the end that tells it from
    /// others.
    static std::string quote(std::string const& path);
};

} // namespace Kv
