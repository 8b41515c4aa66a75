#pragma once

#include "kvExport.h"

#include <cstddef>
#include <cstdint>
#include <dirent.h>
#include <functional>
#include <memory>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

namespace Kv
{

/// One line of a directory's listing: a file, a directory, or a numbered sequence of files. Names are the bytes of the
/// file system.
struct OsDirEntry
{
    /// Of a sequence, the name of its first file.
    std::string name;
    /// What a reader sees: the name, or as "frame.####.exr  1-100" the sequence.
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

/// When a directory was changed last, to find out whether it still is what was read.
struct KV_API OsDirStamp
{
    std::uint64_t device = 0;
    std::uint64_t inode = 0;
    std::int64_t seconds = 0;
    std::int64_t nanoseconds = 0;
    /// The last change was so short before the look that another one could bear the same time.
    bool isFresh = false;

    /// Throws `ExBase`, with the system's words, where the directory cannot be asked or is none.
    static OsDirStamp take(std::string const& directory);

    /// True if neither look missed a change between the two.
    bool isUnchangedIn(OsDirStamp const& later) const;
};

/// Reads a directory a step at a time, so that a loop can run in between whatever the size.
class KV_API OsDirScan
{
public:
    /// How many names one step reads at most.
    static constexpr int namesPerStep = 256;

    struct Options
    {
        /// Names that begin with a dot, all of them or this one.
        bool showsHidden = false;
        std::string hiddenName;
        /// Whether a file of that name may become part of a sequence; none may where there is no function.
        std::function<bool(std::string const&)> collapses;
        /// A text without the difference of cases; without it only that of ASCII goes.
        std::function<std::string(std::string const&)> foldCase;
    };

    /// Throws `ExBase`, with the system's words, where the directory cannot be read.
    OsDirScan(std::string const& directory, Options options);

    /// True once all is read. Throws as the constructor does.
    bool step();

    OsDirStamp const& getStamp() const { return _stamp; }

    /// In no order; complete once `step` has given true.
    std::vector<OsDirEntry> const& getEntries() const { return _entries; }
    std::vector<OsDirEntry> takeEntries() { return std::move(_entries); }

private:
    struct Sequence
    {
        std::size_t entry = 0;
        std::vector<std::uint64_t> numbers;
    };

    struct Closer
    {
        void operator()(DIR* stream) const { closedir(stream); }
    };

    /// False at the end of the directory.
    bool readName();
    void take(char const* name);
    /// True if the file went into the entry of a sequence that is there already.
    bool joinSequence(OsDirEntry const& file);
    void finishSequence(Sequence& sequence);
    std::string makeSortKey(std::string const& name) const;

    std::string _directory;
    Options _options;
    OsDirStamp _stamp;
    std::unique_ptr<DIR, Closer> _stream;
    std::vector<OsDirEntry> _entries;
    std::vector<Sequence> _sequences;
    std::unordered_map<std::string, std::size_t> _sequenceByKey;
    std::size_t _finished = 0;
};

} // namespace Kv
