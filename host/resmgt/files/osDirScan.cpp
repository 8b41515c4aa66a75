#include "files/osDirScan.h"

#include "exBase.h"
#include "files/osNumberedName.h"
#include "files/osPlace.h"

#include <algorithm>
#include <cerrno>
#include <ctime>
#include <fcntl.h>
#include <sys/stat.h>
#include <system_error>
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

OsDirStamp makeStamp(struct stat const& status)
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

} // namespace

OsDirStamp OsDirStamp::take(std::string const& directory)
{
    struct stat status = {};
    if (::stat(directory.c_str(), &status) != 0)
        throwCannotRead(directory);
    errno = ENOTDIR;
    if (!S_ISDIR(status.st_mode))
        throwCannotRead(directory);
    return makeStamp(status);
}

bool OsDirStamp::isUnchangedIn(OsDirStamp const& later) const
{
    return !isFresh && device == later.device && inode == later.inode && seconds == later.seconds &&
           nanoseconds == later.nanoseconds;
}

OsDirScan::OsDirScan(std::string const& directory, Options options)
    : _directory(directory), _options(std::move(options)), _stamp(OsDirStamp::take(directory)),
      _stream(opendir(directory.c_str()))
{
    if (!_stream)
        throwCannotRead(directory);
}

bool OsDirScan::step()
{
    for (int i = 0; i < namesPerStep && _stream; ++i)
        if (!readName())
            _stream.reset();
    if (_stream)
        return false;
    std::size_t const end = std::min(_finished + namesPerStep, _sequences.size());
    for (; _finished < end; ++_finished)
        finishSequence(_sequences[_finished]);
    return _finished == _sequences.size();
}

bool OsDirScan::readName()
{
    errno = 0;
    dirent const* const next = readdir(_stream.get()); // NOLINT(concurrency-mt-unsafe): each scan has its own stream
    if (next)
        take(static_cast<char const*>(next->d_name));
    else if (errno != 0)
        throwCannotRead(_directory);
    return next;
}

void OsDirScan::take(char const* name)
{
    OsDirEntry entry;
    entry.name = name;
    bool const isHidden = entry.name.front() == '.';
    bool const isDots = entry.name == "." || entry.name == "..";
    if (isDots || (isHidden && !_options.showsHidden && entry.name != _options.hiddenName))
        return;
    // A link counts as what it leads to; one that leads nowhere as itself.
    struct stat status = {};
    int const folder = dirfd(_stream.get());
    if (fstatat(folder, name, &status, 0) != 0 && fstatat(folder, name, &status, AT_SYMLINK_NOFOLLOW) != 0)
        return;
    entry.isDirectory = S_ISDIR(status.st_mode);
    entry.size = static_cast<std::uint64_t>(status.st_size);
    entry.modified = status.st_mtim.tv_sec;
    if (S_ISREG(status.st_mode) && joinSequence(entry))
        return;
    entry.title = entry.name;
    entry.sortKey = makeSortKey(entry.name);
    _entries.push_back(std::move(entry));
}

bool OsDirScan::joinSequence(OsDirEntry const& file)
{
    if (!_options.collapses || !_options.collapses(file.name))
        return false;
    std::optional<OsNumberedName> const numbered = OsNumberedName::parse(file.name);
    if (!numbered)
        return false;
    auto const [found, isFirst] = _sequenceByKey.emplace(numbered->getSequenceKey(), _sequences.size());
    if (isFirst)
        _sequences.push_back({_entries.size(), {}});
    Sequence& sequence = _sequences[found->second];
    sequence.numbers.push_back(numbered->number);
    if (isFirst)
        return false;
    OsDirEntry& entry = _entries[sequence.entry];
    // All digits are as many: the first number has the first name.
    entry.name = std::min(entry.name, file.name);
    entry.sequenceKey = found->first;
    entry.size += file.size;
    entry.modified = std::max(entry.modified, file.modified);
    return true;
}

void OsDirScan::finishSequence(Sequence& sequence)
{
    OsDirEntry& entry = _entries[sequence.entry];
    if (entry.sequenceKey.empty())
        return;
    std::sort(sequence.numbers.begin(), sequence.numbers.end());
    entry.title = OsNumberedName::parse(entry.name)->getPattern() + "  " + OsNumberedName::describe(sequence.numbers);
    entry.sortKey = makeSortKey(entry.name);
}

std::string OsDirScan::makeSortKey(std::string const& name) const
{
    std::string const text = !_options.foldCase || isAscii(name) ? lowerAscii(name) : _options.foldCase(name);
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

} // namespace Kv
