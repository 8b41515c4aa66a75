#pragma once

#include <atomic>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

namespace Kv
{

/// One line of a directory's listing: a file, a directory, or a numbered sequence of files. Names are the bytes of the
/// file system.
struct QtDirEntry
{
    /// Of a sequence, the name of its first file.
    std::string name;
    /// The text that a reader sees: the name, or as "frame.####.exr  1-100" the sequence.
    std::string title;
    /// In the order of these bytes names come as people count, "a2" before "a10", whatever the case.
    std::string sortKey;
    /// Set for a sequence: what its files share.
    std::string sequenceKey;
    bool isDirectory = false;
    /// In bytes; of a sequence, of all its files.
    std::uint64_t size = 0;
    /// In seconds since 1970; of a sequence, of the latest file.
    std::int64_t modified = 0;
};

/// Time of the last change of a directory, to find out whether it still is what was read.
struct QtDirStamp
{
    std::uint64_t device = 0;
    std::uint64_t inode = 0;
    std::int64_t seconds = 0;
    std::int64_t nanoseconds = 0;
    /// The last change was so short before the look that another one could bear the same time.
    bool isFresh = false;

    /// Throws `ExBase`, with the system's words, where the directory cannot be asked or is none.
    static QtDirStamp take(std::string const& directory);

    /// True if neither look missed a change between the two.
    bool isUnchangedIn(QtDirStamp const& later) const;
};

/// A directory as it was read. It is made and sorted on any thread.
class QtDirListing
{
public:
    struct Options
    {
        /// Names that begin with a dot, all of them or this one.
        bool showsHidden = false;
        std::string hiddenName;
        /// Whether an entry is a directory, its size and its time are asked for, which one that hangs keeps from its
        /// neighbours too. Without that directories are known, but those that a link leads to.
        bool asksEntries = true;
        /// True for the name of a file that may become part of a sequence; none may where there is no function. Called
        /// on the thread that reads.
        std::function<bool(std::string const&)> collapses;
    };

    enum Key
    {
        Name,
        Size,
        Modified,
    };

    QtDirListing() = default;

    /// Reads a directory; stops early, with what there is by then, once `cancelled` is true. Throws an `ExBase`, with
    /// the system's words, where the directory cannot be read.
    QtDirListing(std::string const& directory, Options const& options, std::atomic<bool> const& cancelled);

    QtDirStamp const& getStamp() const { return _stamp; }

    /// False if the entries have neither a size nor a time.
    bool hasDetails() const { return _hasDetails; }

    /// In no order.
    std::vector<QtDirEntry> const& getEntries() const { return _entries; }

    /// The indices of the entries in an order. Directories always come first; what counts alike comes by its name.
    std::vector<int> sort(Key key, bool descending) const;

private:
    QtDirStamp _stamp;
    bool _hasDetails = true;
    std::vector<QtDirEntry> _entries;
};

} // namespace Kv
