#include "browser/qtDirListing.h"

#include "browser/qtNumberedName.h"
#include "exBase.h"
#include "files/osPlace.h"
#include "peers/qtText.h"

#include <algorithm>
#include <cerrno>
#include <cstddef>
#include <ctime>
#include <dirent.h>
#include <fcntl.h>
#include <memory>
#include <numeric>
#include <optional>
#include <sys/stat.h>
#include <system_error>
#include <unordered_map>
#include <utility>

namespace Kv
{

namespace
{

[[noreturn]] void throwCannotRead(std::string const& directory)
{
    throw ExBase(__FILE__, __LINE__,
                 "Cannot read " + OsPlace::quote(directory) + ": " + std::generic_category().message(errno));
}

/// File systems keep times no finer than the kernel's clock ticks; two changes within one tick bear one time.
constexpr std::int64_t tickNanoseconds = 100'000'000;

std::int64_t toNanoseconds(timespec const& time)
{
    return static_cast<std::int64_t>(time.tv_sec) * 1'000'000'000 + time.tv_nsec;
}

QtDirStamp makeStamp(struct stat const& status)
{
    timespec now{};
    clock_gettime(CLOCK_REALTIME, &now);
    bool const isFresh = toNanoseconds(now) - toNanoseconds(status.st_mtim) < tickNanoseconds;
    return {status.st_dev, status.st_ino, status.st_mtim.tv_sec, status.st_mtim.tv_nsec, isFresh};
}

bool isAscii(std::string const& text)
{
    return std::all_of(text.begin(), text.end(), [](char c) { return static_cast<unsigned char>(c) < 0x80; });
}

std::string lowerAscii(std::string text)
{
    for (char& c : text)
        if (c >= 'A' && c <= 'Z')
            c = static_cast<char>(c - 'A' + 'a');
    return text;
}

bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

/// Bytes in whose order names come as people count.
std::string makeSortKey(std::string const& name)
{
    std::string const text = isAscii(name) ? lowerAscii(name) : toQString(name).toCaseFolded().toStdString();
    std::string key;
    for (std::size_t i = 0; i < text.size();)
    {
        if (!isDigit(text[i]))
        {
            key += text[i++];
            continue;
        }
        // A number is its length, then its digits: of two the longer one is the greater.
        std::size_t const zeros = std::min(text.find_first_not_of('0', i), text.size()) - i;
        std::size_t const end = std::min(text.find_first_not_of("0123456789", i), text.size());
        std::size_t const begin = std::min(i + zeros, end);
        key += '0';
        key += static_cast<char>(end - begin);
        key.append(text, begin, end - begin);
        i = end;
    }
    // Names that count alike still have one order.
    return key + '\0' + name;
}

template <typename Number> int compare(Number a, Number b)
{
    return a < b ? -1 : int(b < a);
}

/// True if the first entry comes before the second.
bool comesBefore(QtDirEntry const& first, QtDirEntry const& second, QtDirListing::Key key, bool descending)
{
    if (first.isDirectory != second.isDirectory)
        return first.isDirectory;
    int order = 0;
    // A directory's own size says nothing.
    if (key == QtDirListing::Size && !first.isDirectory)
        order = compare(first.size, second.size);
    else if (key == QtDirListing::Modified)
        order = compare(first.modified, second.modified);
    if (order == 0)
        order = first.sortKey.compare(second.sortKey);
    return descending ? order > 0 : order < 0;
}

/// Reads the names of a directory, and puts those of a sequence into one entry.
class Reader
{
public:
    Reader(std::string const& directory, QtDirListing::Options const& options)
        : _directory(directory), _options(options), _stream(opendir(directory.c_str()))
    {
        if (!_stream)
            throwCannotRead(directory);
    }

    std::vector<QtDirEntry> read(std::atomic<bool> const& cancelled)
    {
        while (!cancelled && readName())
            continue;
        for (Sequence& sequence : _sequences)
            finishSequence(sequence);
        return std::move(_entries);
    }

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
    void take(dirent const& found);
    /// Nothing for an entry that has gone meanwhile.
    std::optional<struct stat> findStatus(dirent const& found) const;
    /// True if the file went into the entry of a sequence that is there already.
    bool joinSequence(QtDirEntry const& file);
    void finishSequence(Sequence& sequence);

    std::string const& _directory;
    QtDirListing::Options const& _options;
    std::unique_ptr<DIR, Closer> _stream;
    std::vector<QtDirEntry> _entries;
    std::vector<Sequence> _sequences;
    std::unordered_map<std::string, std::size_t> _sequenceByKey;
};

bool Reader::readName()
{
    errno = 0;
    dirent const* const next = readdir(_stream.get()); // NOLINT(concurrency-mt-unsafe): each reader has its own stream
    if (next)
        take(*next);
    else if (errno != 0)
        throwCannotRead(_directory);
    return next;
}

void Reader::take(dirent const& found)
{
    QtDirEntry entry;
    entry.name = static_cast<char const*>(found.d_name);
    bool const isHidden = entry.name.front() == '.';
    bool const isDots = entry.name == "." || entry.name == "..";
    if (isDots || (isHidden && !_options.showsHidden && entry.name != _options.hiddenName))
        return;
    auto const status = findStatus(found);
    if (!status)
        return;
    entry.isDirectory = S_ISDIR(status->st_mode);
    entry.size = static_cast<std::uint64_t>(status->st_size);
    entry.modified = status->st_mtim.tv_sec;
    if (S_ISREG(status->st_mode) && joinSequence(entry))
        return;
    entry.title = entry.name;
    entry.sortKey = makeSortKey(entry.name);
    _entries.push_back(std::move(entry));
}

std::optional<struct stat> Reader::findStatus(dirent const& found) const
{
    struct stat status = {};
    status.st_mode = DTTOIF(found.d_type);
    // A link counts as what it leads to; one that leads nowhere as itself.
    if (_options.asksEntries && fstatat(dirfd(_stream.get()), found.d_name, &status, 0) != 0 &&
        fstatat(dirfd(_stream.get()), found.d_name, &status, AT_SYMLINK_NOFOLLOW) != 0)
        return std::nullopt;
    return status;
}

bool Reader::joinSequence(QtDirEntry const& file)
{
    if (!_options.collapses || !_options.collapses(file.name))
        return false;
    std::optional<QtNumberedName> const numbered = QtNumberedName::parse(file.name);
    if (!numbered)
        return false;
    auto const [found, isFirst] = _sequenceByKey.emplace(numbered->getSequenceKey(), _sequences.size());
    if (isFirst)
        _sequences.push_back({_entries.size(), {}});
    Sequence& sequence = _sequences[found->second];
    sequence.numbers.push_back(numbered->number);
    if (isFirst)
        return false;
    QtDirEntry& entry = _entries[sequence.entry];
    // All digits are as many: the first number has the first name.
    entry.name = std::min(entry.name, file.name);
    entry.sequenceKey = found->first;
    entry.size += file.size;
    entry.modified = std::max(entry.modified, file.modified);
    return true;
}

void Reader::finishSequence(Sequence& sequence)
{
    QtDirEntry& entry = _entries[sequence.entry];
    if (entry.sequenceKey.empty())
        return;
    std::sort(sequence.numbers.begin(), sequence.numbers.end());
    entry.title = QtNumberedName::parse(entry.name)->getPattern() + "  " + QtNumberedName::describe(sequence.numbers);
    entry.sortKey = makeSortKey(entry.name);
}

} // namespace

QtDirStamp QtDirStamp::take(std::string const& directory)
{
    struct stat status = {};
    if (::stat(directory.c_str(), &status) != 0)
        throwCannotRead(directory);
    errno = ENOTDIR;
    if (!S_ISDIR(status.st_mode))
        throwCannotRead(directory);
    return makeStamp(status);
}

bool QtDirStamp::isUnchangedIn(QtDirStamp const& later) const
{
    return !isFresh && device == later.device && inode == later.inode && seconds == later.seconds &&
           nanoseconds == later.nanoseconds;
}

QtDirListing::QtDirListing(std::string const& directory, Options const& options, std::atomic<bool> const& cancelled)
    : _stamp(QtDirStamp::take(directory)), _hasDetails(options.asksEntries),
      _entries(Reader(directory, options).read(cancelled))
{
}

std::vector<int> QtDirListing::sort(Key key, bool descending) const
{
    std::vector<int> order(_entries.size());
    std::iota(order.begin(), order.end(), 0);
    std::sort(order.begin(), order.end(),
              [&](int a, int b) {
                  return comesBefore(_entries[static_cast<std::size_t>(a)], _entries[static_cast<std::size_t>(b)], key,
                                     descending);
              });
    return order;
}

} // namespace Kv
