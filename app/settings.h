#pragma once

#include <QSettings>

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace Velmora
{

/// The memory of the application from one run to the next, in the user's configuration folder. What cannot be read is
/// as if it had never been set, and what cannot be written holds for this run. Threads read and write the file, one
/// after the other, and nobody waits long for them: the folder may lie in a network that does not answer.
class Settings
{
public:
    /// An application that is to remember nothing reads nothing either.
    explicit Settings(bool remembers);
    Settings(Settings const&) = delete;
    Settings& operator=(Settings const&) = delete;
    /// Writes what is new.
    ~Settings();

    /// Absolute paths in the bytes of the file system, the one that ran last first.
    std::vector<std::string> getScripts() const;
    void addScript(std::string const& path);
    void removeScript(std::string const& path);
    void clearScripts();

    /// The window's own record of its look; empty if there is none.
    QByteArray getLook(QString const& part) const;
    /// It is written at the end.
    void setLook(QString const& part, QByteArray const& look);

private:
    /// For those threads alone; none until the first of them reads it.
    using File = std::optional<QSettings>;

    void changeScripts(std::function<void(std::vector<std::string>&)> const& change);
    /// What a thread does to have `act` done with the file.
    template <typename Act> auto makeWork(Act act) const;

    std::string _path;
    /// Null if nothing is remembered.
    std::shared_ptr<File> _file;
    /// As they were when the file was read last, with the changes since then.
    mutable std::vector<std::string> _scripts;
};

} // namespace Velmora
