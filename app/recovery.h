#pragma once

#include "files/osLockedFile.h"
#include "fwComposition.h"
#include "pointers/rcWeakPtr.h"
#include "uiCompositionWorkspace.h"

#include <QElapsedTimer>
#include <QString>
#include <QTimer>

#include <atomic>
#include <cstdint>
#include <ctime>
#include <functional>
#include <future>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include <unistd.h>

namespace Velmora
{

/// Keeps the changes of the open compositions that are not saved, each composition in a file in the user's folder for
/// the state of programs, for the case that the process ends before its time. Such a file belongs to the process while
/// that lives, and to the next one that takes it afterwards. Threads write and remove the files, one after the other,
/// and nobody waits long for them: the folder may lie in a network that does not answer.
class Recovery final
{
public:
    /// The file of a composition, for those threads alone once it is handed to one of them.
    struct File
    {
        /// None until it is written for the first time.
        std::optional<Kv::OsLockedFile> file;
        /// Of the changes that are in it; for all threads.
        std::atomic<std::uint64_t> changeCount = 0;
    };

    /// A composition whose changes were left by a process that has ended.
    struct Left
    {
        std::shared_ptr<File> file;
        Kv::FwComposition::Keeper composition;
        /// When it was changed last.
        std::time_t time;
    };

    /// What was found, and words about each file that cannot be read.
    struct Findings
    {
        std::vector<Left> left;
        std::vector<std::string> refusals;
    };

    /// `tell` is called once, with words, if changes cannot be kept.
    Recovery(Kv::UiCompositionWorkspace& workspace, std::function<void(QString const&)> tell);
    Recovery(Recovery const&) = delete;
    Recovery& operator=(Recovery const&) = delete;

    /// To be called for each change of the workspace. Writes what is new at once where nothing was written for a while,
    /// and else a little later.
    void follow();

    /// Writes all that is new now; waits for two seconds at most. Uses neither Qt's windows nor the interpreter.
    void keepNow() noexcept;

    /// The application ends in order: nothing is kept, now or later. Waits for two seconds at most.
    void discard() noexcept;

    /// The same, but what is not saved is left for the next start.
    void leave() noexcept;

    /// Takes what is left. A file that holds no changes is put aside. A folder that does not answer within two seconds
    /// is refused.
    Findings find();

    /// Opens the composition with its changes, in the place of an open one that has none. Throws `ExBase` with words;
    /// what is left is then as it was.
    void restore(Left& left);

    /// Removes what is left.
    void throwAway(Left const& left);

private:
    using Composition = Kv::RCWeakPtr<const Kv::PiCompositionGraphInterface>;

    struct Kept
    {
        Composition composition;
        std::shared_ptr<File> file;
    };

    /// What a thread is to write.
    struct Change
    {
        std::shared_ptr<File> file;
        /// That of a file that is yet to be made begins with it.
        std::string name;
        std::string content;
        std::uint64_t changeCount;
    };

    /// A forked process leaves all to its parent.
    bool isKeeper() const { return !_isOver && getpid() == _process; }
    /// Each gives the words of the first failure; empty without one.
    std::string removeAndWrite();
    std::string write();
    void startWriting();
    void removeSaved();
    void startRemoving(std::vector<std::shared_ptr<File>> const& files);
    bool isUnsaved(Composition const& composition) const;
    std::shared_ptr<File> getFile(Composition const& composition);
    static void write(Change const& change, std::string const& folder);

    /// Has what gives such words done in a thread, after all that was started before.
    void start(std::function<std::string()> work);
    /// Both wait for what was started last.
    void waitAMoment() const;
    void waitLonger() const;
    bool isUnderWay() const;
    /// The words of what was started last, once.
    std::string takeFailure();

    void find(std::string const& path, Findings& findings) const;
    std::string putAside(Kv::OsLockedFile& file) const;

    Kv::UiCompositionWorkspace& _workspace;
    std::function<void(QString const&)> _tell;
    std::string _folder;
    pid_t _process;
    std::vector<Kept> _kept;
    /// Of what was started last.
    std::future<std::string> _outcome;
    QTimer _timer;
    QElapsedTimer _sinceWritten;
    qint64 _pause = 0;
    bool _isTold = false;
    bool _isOver = false;
};

} // namespace Velmora
