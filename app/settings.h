#pragma once

#include <QSettings>

#include <optional>
#include <string>
#include <vector>

namespace Velmora
{

/// The memory of the application from one run to the next, in the user's configuration folder. What cannot be read is
/// as if it had never been set, and what cannot be written holds for this run.
class Settings
{
public:
    /// An application that is to remember nothing reads nothing either.
    explicit Settings(bool remembers);

    /// Absolute paths in the bytes of the file system, the one that ran last first.
    std::vector<std::string> getScripts() const;
    void addScript(std::string const& path);
    void removeScript(std::string const& path);
    void clearScripts();

    /// The window's own record of its look; empty if there is none.
    QByteArray getLook(QString const& part) const;
    void setLook(QString const& part, QByteArray const& look);

private:
    void setScripts(std::vector<std::string> const& paths);

    mutable std::optional<QSettings> _file;
};

} // namespace Velmora
