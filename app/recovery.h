#pragma once

#include "files/osLockedFile.h"
#include "fwComposition.h"
#include "pointers/rcWeakPtr.h"
#include "uiCompositionWorkspace.h"

#include <QElapsedTimer>
#include <QString>
#include <QTimer>

#include <cstdint>
#include <ctime>
#include <functional>
#include <string>
#include <vector>

namespace Velmora
{

/// Keeps the changes of the open compositions that are not saved, each composition in a file in the user's folder for
/// the state of programs, for the case that the process ends before its time. Such a file belongs to the process while
/// that lives, and to the next one that takes it afterwards.
class Recovery final
{
public:
    /// A composition whose changes were left by a process that has ended.
    struct Left
    {
        Kv::OsLockedFile file;
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

    /// Writes all that is new now. Uses neither Qt's windows nor the interpreter.
    void keepNow() noexcept;

    /// The application ends in order: nothing is kept, now or later.
    void discard() noexcept;

    /// The same, but what is not saved is left for the next start.
    void leave() noexcept;

    /// Takes what is left. A file that holds no changes is put aside.
    Findings find() const;

    /// Opens the composition with its changes, in the place of an open one that has none. Throws `ExBase` with words;
    /// what is left is then as it was.
    void restore(Left& left);

private:
    using Composition = Kv::RCWeakPtr<const Kv::PiCompositionGraphInterface>;

    struct Kept
    {
        Composition composition;
        Kv::OsLockedFile file;
        std::uint64_t changeCount;
    };

    void removeSaved();
    bool isUnsaved(Composition const& composition) const;
    /// Gives the words of the first failure; empty without one.
    std::string write();
    bool isKept(Composition const& composition, std::uint64_t changeCount) const;
    void keep(Composition const& composition);
    void find(std::string const& path, Findings& findings) const;
    std::string putAside(Kv::OsLockedFile& file) const;

    Kv::UiCompositionWorkspace& _workspace;
    std::function<void(QString const&)> _tell;
    std::string _folder;
    std::vector<Kept> _kept;
    QTimer _timer;
    QElapsedTimer _sinceWritten;
    qint64 _pause = 0;
    bool _isTold = false;
    bool _isOver = false;
};

} // namespace Velmora
