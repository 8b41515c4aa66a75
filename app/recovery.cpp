#include "recovery.h"

#include "exBase.h"
#include "files/osAsync.h"
#include "files/osFile.h"
#include "text/liString.h"

#include <QByteArray>
#include <QDir>
#include <QObject>

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <exception>
#include <filesystem>
#include <iterator>
#include <optional>
#include <sstream>
#include <sys/stat.h>
#include <system_error>
#include <utility>

namespace Velmora
{

namespace
{

namespace fs = std::filesystem;

using Kv::ExBase;
using Kv::PiUnsavedComposition;

/// A file begins with a line of its own: this word, the version of the format, the path of the composition's file and
/// the version of that. What follows is the composition as a save would write it.
constexpr char const* firstWord = "velmora-recovery";
constexpr int formatVersion = 1;
constexpr int wordCount = 4;

constexpr char const* extension = ".vmrecovery";

/// The least time between two writes, in milliseconds, and the share of the time that writing may take.
constexpr qint64 leastPause = 2000;
constexpr qint64 shareOfTime = 20;

std::string getFolder()
{
    QByteArray const state = qgetenv("XDG_STATE_HOME");
    std::string const base =
        state.startsWith('/') ? state.toStdString() : QDir::homePath().toStdString() + "/.local/state";
    return base + "/velmora/recovery";
}

/// With all the folders above it that are not there.
void makeFolder(fs::path const& folder)
{
    if (fs::is_directory(folder))
        return;
    makeFolder(folder.parent_path());
    constexpr mode_t forUserAlone = S_IRWXU;
    // Another application may make it just now.
    if (mkdir(folder.c_str(), forUserAlone) != 0 && errno != EEXIST)
        throw fs::filesystem_error("Cannot make a folder", folder, std::error_code(errno, std::generic_category()));
}

/// In one word of printable characters.
std::string encode(std::string const& bytes, char const* kept = "")
{
    return QByteArray::fromStdString(bytes).toPercentEncoding(kept).toStdString();
}

std::string decode(QByteArray const& word)
{
    return QByteArray::fromPercentEncoding(word).toStdString();
}

std::string write(Kv::OsFile::Version const& version)
{
    std::string text;
    for (long long const number : version)
        text += std::to_string(number) + ' ';
    return text;
}

/// Numbers that are not there are zero: the file is then another one.
Kv::OsFile::Version readVersion(std::string const& text)
{
    Kv::OsFile::Version version{};
    std::istringstream stream(text);
    for (long long& number : version)
        stream >> number;
    return version;
}

std::string writeRecord(PiUnsavedComposition const& unsaved)
{
    return std::string(firstWord) + ' ' + std::to_string(formatVersion) + ' ' + encode(unsaved.path.toString(), "/") +
           ' ' + encode(write(unsaved.version)) + '\n' + unsaved.text;
}

/// In place of the first line the text has an empty one: the others have the numbers that they have in the file.
PiUnsavedComposition readRecord(std::string const& content)
{
    std::size_t const end = std::min(content.find('\n'), content.size());
    QList<QByteArray> const words = QByteArray::fromStdString(content.substr(0, end)).split(' ');
    if (words.size() < 2 || words[0] != firstWord)
        throw ExBase(__FILE__, __LINE__, "line 1: it does not begin as such a file");
    if (words[1].toInt() > formatVersion)
        throw ExBase(__FILE__, __LINE__, "line 1: a later version of the application has written it");
    if (words.size() != wordCount || !words[2].startsWith('/'))
        throw ExBase(__FILE__, __LINE__, "line 1: it does not name a composition");
    return {Kv::OsFilePath(decode(words[2])), readVersion(decode(words[3])), content.substr(end)};
}

/// True if nothing is left to be saved: the process ended when it had just done so.
bool isSaved(PiUnsavedComposition const& unsaved)
{
    try
    {
        return '\n' + Kv::OsFile(unsaved.path).read(unsaved.text.size()) == unsaved.text;
    }
    catch (ExBase const&)
    {
        return false;
    }
}

/// The paths of the files that are there, in order.
std::vector<std::string> list(std::string const& folder)
{
    std::vector<std::string> paths;
    std::error_code error;
    for (fs::directory_iterator file(folder, error); !error && file != fs::directory_iterator(); file.increment(error))
        if (file->path().extension() == extension)
            paths.push_back(file->path());
    std::sort(paths.begin(), paths.end());
    return paths;
}

std::string describeSilence(std::string const& folder)
{
    return Kv::LiStringUtil::getPrintablePath(folder) + ": its file system does not answer";
}

} // namespace

Recovery::Recovery(Kv::UiCompositionWorkspace& workspace, std::function<void(QString const&)> tell)
    : _workspace(workspace), _tell(std::move(tell)), _folder(getFolder()), _process(getpid())
{
    _timer.setSingleShot(true);
    QObject::connect(&_timer, &QTimer::timeout, &_timer, [this] { follow(); });
}

void Recovery::follow()
{
    if (!isKeeper())
        return;
    std::string failure;
    try
    {
        failure = removeAndWrite();
    }
    catch (std::exception const& error)
    {
        failure = error.what();
    }
    if (failure.empty() && !isUnderWay())
        return;
    if (!_timer.isActive())
        _timer.start(static_cast<int>(std::max(leastPause, _pause)));
    if (!failure.empty() && !std::exchange(_isTold, true))
        _tell(QObject::tr("Changes that are not saved cannot be kept for the case of a crash: %1")
                  .arg(QString::fromStdString(failure)));
}

void Recovery::keepNow() noexcept
{
    try
    {
        if (!isKeeper())
            return;
        startWriting();
        waitLonger();
    }
    catch (...)
    {
        // What was written before is there still.
    }
}

void Recovery::discard() noexcept
{
    try
    {
        if (isKeeper())
        {
            std::vector<std::shared_ptr<File>> files;
            for (Kept const& kept : _kept)
                files.push_back(kept.file);
            startRemoving(files);
            waitLonger();
        }
    }
    catch (...)
    {
        // The next start offers what is there still.
    }
    _kept.clear();
    _isOver = true;
}

void Recovery::leave() noexcept
{
    keepNow();
    _kept.clear();
    _isOver = true;
}

Recovery::Findings Recovery::find()
{
    auto const paths = std::make_shared<std::vector<std::string>>();
    start(
        [folder = _folder, paths]
        {
            *paths = list(folder);
            return std::string();
        });
    waitLonger();
    if (isUnderWay())
        return {{}, {describeSilence(_folder)}};
    Findings findings;
    for (std::string const& path : *paths)
        find(path, findings);
    return findings;
}

void Recovery::find(std::string const& path, Findings& findings) const
{
    std::string place = path;
    std::string words;
    try
    {
        std::optional<Kv::OsLockedFile> file = Kv::OsLockedFile::take(Kv::OsFilePath(path));
        if (!file)
            return;
        constexpr std::uint64_t maxSize = std::uint64_t(512) << 20;
        std::string const content = Kv::OsFile(file->getPath()).read(maxSize);
        try
        {
            PiUnsavedComposition const unsaved = content.empty() ? PiUnsavedComposition() : readRecord(content);
            // An empty one was made by a process that then ended at once.
            if (content.empty() || isSaved(unsaved))
            {
                file->remove();
                return;
            }
            Kv::FwComposition::Keeper const composition = Kv::FwComposition::restoreApart(unsaved);
            std::time_t const time = file->getTime();
            auto const kept = std::make_shared<File>();
            kept->file = std::move(file);
            findings.left.push_back({kept, composition, time});
            return;
        }
        catch (ExBase const& error)
        {
            words = error.what();
            place = putAside(*file);
        }
    }
    catch (std::exception const& error)
    {
        words = error.what();
    }
    findings.refusals.push_back(Kv::LiStringUtil::getPrintablePath(place) + ": " + words);
}

void Recovery::restore(Left& left)
{
    Composition const composition = *left.composition;
    Kv::RCWeakAccessor<const Kv::PiCompositionGraphInterface> const restored(composition);
    for (auto open = _workspace.getCompositions(); !open.atEnd(); ++open)
    {
        Kv::RCWeakAccessor<const Kv::PiCompositionGraphInterface> const other(*open);
        if (!other.isNull() && other->getPath() == restored->getPath() && !other->isModified())
        {
            _workspace.close(*open);
            break;
        }
    }
    left.file->changeCount = restored->getChangeCount();
    _kept.push_back({composition, left.file});
    try
    {
        _workspace.openComposition(composition);
    }
    catch (ExBase const&)
    {
        _kept.pop_back();
        throw;
    }
}

void Recovery::throwAway(Left const& left)
{
    startRemoving({left.file});
    waitAMoment();
}

std::string Recovery::removeAndWrite()
{
    bool const isLate = isUnderWay();
    removeSaved();
    qint64 const rest = _sinceWritten.isValid() ? _pause - _sinceWritten.elapsed() : 0;
    if (rest > 0)
    {
        if (!_timer.isActive())
            _timer.start(static_cast<int>(rest));
        return {};
    }
    if (isUnderWay())
        return isLate ? describeSilence(_folder) : std::string();
    std::string const failure = takeFailure();
    return failure.empty() ? write() : failure;
}

void Recovery::removeSaved()
{
    auto const firstSaved = std::stable_partition(_kept.begin(), _kept.end(),
                                                  [this](Kept const& kept) { return isUnsaved(kept.composition); });
    std::vector<std::shared_ptr<File>> files;
    std::transform(firstSaved, _kept.end(), std::back_inserter(files), [](Kept const& kept) { return kept.file; });
    startRemoving(files);
    _kept.erase(firstSaved, _kept.end());
    if (!files.empty())
        waitAMoment();
}

void Recovery::startRemoving(std::vector<std::shared_ptr<File>> const& files)
{
    if (files.empty())
        return;
    start(
        [files]
        {
            for (std::shared_ptr<File> const& kept : files)
            {
                if (kept->file)
                    kept->file->remove();
                kept->file.reset();
            }
            return std::string();
        });
}

/// Whoever goes through one that is closed holds it a little longer: it is looked for among the open ones.
bool Recovery::isUnsaved(Composition const& composition) const
{
    for (auto open = _workspace.getCompositions(); !open.atEnd(); ++open)
        if (*open == composition)
            return Kv::RCWeakAccessor(composition)->isModified();
    return false;
}

std::string Recovery::write()
{
    QElapsedTimer cost;
    cost.start();
    startWriting();
    if (!_outcome.valid())
        return {};
    waitAMoment();
    _pause = std::max(leastPause, cost.elapsed() * shareOfTime);
    _sinceWritten.start();
    return takeFailure();
}

void Recovery::startWriting()
{
    std::vector<Change> changes;
    for (auto open = _workspace.getCompositions(); !open.atEnd(); ++open)
    {
        Kv::RCWeakAccessor<const Kv::PiCompositionGraphInterface> const composition(*open);
        if (composition.isNull() || !composition->isModified())
            continue;
        std::shared_ptr<File> const file = getFile(*open);
        if (file->changeCount == composition->getChangeCount())
            continue;
        // The name is for people, who may have to look for their work in that folder.
        constexpr std::size_t maxLength = 100;
        changes.push_back({file, encode(composition->getGraph()->getName()).substr(0, maxLength),
                           writeRecord(composition->getUnsaved()), composition->getChangeCount()});
    }
    if (changes.empty())
        return;
    start(
        [folder = _folder, changes = std::move(changes)]
        {
            std::string failure;
            for (Change const& change : changes)
                try
                {
                    write(change, folder);
                }
                catch (std::exception const& error)
                {
                    failure = error.what();
                }
            return failure;
        });
}

std::shared_ptr<Recovery::File> Recovery::getFile(Composition const& composition)
{
    auto const kept =
        std::find_if(_kept.begin(), _kept.end(), [&](Kept const& other) { return other.composition == composition; });
    if (kept != _kept.end())
        return kept->file;
    _kept.push_back({composition, std::make_shared<File>()});
    return _kept.back().file;
}

void Recovery::write(Change const& change, std::string const& folder)
{
    std::optional<Kv::OsLockedFile>& file = change.file->file;
    if (!file)
    {
        makeFolder(folder);
        file = Kv::OsLockedFile::create(Kv::OsFilePath(folder), change.name + '.', extension);
    }
    file->replace(change.content);
    change.file->changeCount = change.changeCount;
}

void Recovery::start(std::function<std::string()> work)
{
    _outcome = Kv::OsAsync::entrust(_folder, std::move(work));
}

void Recovery::waitAMoment() const
{
    if (_outcome.valid())
        Kv::OsAsync::comes(_folder, _outcome);
}

void Recovery::waitLonger() const
{
    if (_outcome.valid())
        _outcome.wait_for(Kv::OsAsync::longPatience);
}

bool Recovery::isUnderWay() const
{
    return _outcome.valid() && _outcome.wait_for(std::chrono::seconds(0)) != std::future_status::ready;
}

std::string Recovery::takeFailure()
{
    return _outcome.valid() && !isUnderWay() ? _outcome.get() : std::string();
}

/// Gives the new path.
std::string Recovery::putAside(Kv::OsLockedFile& file) const
{
    std::string const folder = _folder + "/unreadable";
    makeFolder(folder);
    std::string const path = folder + '/' + file.getPath().getFileName();
    std::string free = path;
    for (int number = 2; fs::exists(free); ++number)
        free = path + '.' + std::to_string(number);
    file.move(Kv::OsFilePath(free));
    return free;
}

} // namespace Velmora
