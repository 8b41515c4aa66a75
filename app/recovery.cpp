#include "recovery.h"

#include "exBase.h"
#include "files/osFile.h"
#include "text/liString.h"

#include <QByteArray>
#include <QDir>
#include <QObject>

#include <algorithm>
#include <cerrno>
#include <exception>
#include <filesystem>
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

} // namespace

Recovery::Recovery(Kv::UiCompositionWorkspace& workspace, std::function<void(QString const&)> tell)
    : _workspace(workspace), _tell(std::move(tell)), _folder(getFolder())
{
    _timer.setSingleShot(true);
    QObject::connect(&_timer, &QTimer::timeout, &_timer, [this] { follow(); });
}

void Recovery::follow()
{
    if (_isOver)
        return;
    removeSaved();
    qint64 const rest = _sinceWritten.isValid() ? _pause - _sinceWritten.elapsed() : 0;
    if (rest > 0)
    {
        if (!_timer.isActive())
            _timer.start(static_cast<int>(rest));
        return;
    }
    std::string const failure = write();
    if (failure.empty())
        return;
    _timer.start(static_cast<int>(_pause));
    if (!std::exchange(_isTold, true))
        _tell(QObject::tr("Changes that are not saved cannot be kept for the case of a crash: %1")
                  .arg(QString::fromStdString(failure)));
}

void Recovery::keepNow() noexcept
{
    try
    {
        if (!_isOver)
            write();
    }
    catch (...)
    {
        // What was written before is there still.
    }
}

void Recovery::discard() noexcept
{
    for (Kept& kept : _kept)
        kept.file.remove();
    _kept.clear();
    _isOver = true;
}

void Recovery::leave() noexcept
{
    keepNow();
    _kept.clear();
    _isOver = true;
}

Recovery::Findings Recovery::find() const
{
    std::vector<std::string> paths;
    std::error_code error;
    for (fs::directory_iterator file(_folder, error); !error && file != fs::directory_iterator(); file.increment(error))
        if (file->path().extension() == extension)
            paths.push_back(file->path());
    std::sort(paths.begin(), paths.end());
    Findings findings;
    for (std::string const& path : paths)
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
            findings.left.push_back({std::move(*file), composition, time});
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
    _kept.push_back({composition, std::move(left.file), restored->getChangeCount()});
    try
    {
        _workspace.openComposition(composition);
    }
    catch (ExBase const&)
    {
        left.file = std::move(_kept.back().file);
        _kept.pop_back();
        throw;
    }
}

void Recovery::removeSaved()
{
    auto const isOver = [this](Kept& kept)
    {
        if (isUnsaved(kept.composition))
            return false;
        kept.file.remove();
        return true;
    };
    _kept.erase(std::remove_if(_kept.begin(), _kept.end(), isOver), _kept.end());
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
    bool isNew = false;
    std::string failure;
    for (auto open = _workspace.getCompositions(); !open.atEnd(); ++open)
    {
        Kv::RCWeakAccessor<const Kv::PiCompositionGraphInterface> const composition(*open);
        if (composition.isNull() || !composition->isModified() || isKept(*open, composition->getChangeCount()))
            continue;
        isNew = true;
        try
        {
            keep(*open);
        }
        catch (std::exception const& error)
        {
            failure = error.what();
        }
    }
    if (isNew)
    {
        _pause = std::max(leastPause, cost.elapsed() * shareOfTime);
        _sinceWritten.start();
    }
    return failure;
}

bool Recovery::isKept(Composition const& composition, std::uint64_t changeCount) const
{
    return std::any_of(_kept.begin(), _kept.end(),
                       [&](Kept const& kept)
                       { return kept.composition == composition && kept.changeCount == changeCount; });
}

void Recovery::keep(Composition const& composition)
{
    Kv::RCWeakAccessor<const Kv::PiCompositionGraphInterface> const accessor(composition);
    auto kept =
        std::find_if(_kept.begin(), _kept.end(), [&](Kept const& other) { return other.composition == composition; });
    if (kept == _kept.end())
    {
        makeFolder(_folder);
        // The name is for people, who may have to look for their work in that folder.
        constexpr std::size_t maxLength = 100;
        std::string const name = encode(accessor->getGraph()->getName()).substr(0, maxLength);
        Kv::OsLockedFile file = Kv::OsLockedFile::create(Kv::OsFilePath(_folder), name + '.', extension);
        kept = _kept.insert(_kept.end(), {composition, std::move(file), 0});
    }
    kept->file.replace(writeRecord(accessor->getUnsaved()));
    kept->changeCount = accessor->getChangeCount();
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
