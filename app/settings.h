#pragma once

#include <QSettings>

#include <optional>
#include <string>
#include <vector>

namespace Velmora
{

/// What the application remembers from one run to the next, in the user's configuration folder. What cannot be read is
/// as if it had never been set, and what cannot be written holds for this run.
class Settings
{
public:
    /// Where nothing is to be remembered there is nothing to be read either.
    explicit Settings(bool remembers);

    /// Absolute paths in the bytes of the file system, the one that ran last first.
    std::vector<std::string> getScripts() const;
    void addScript(std::string const& path);
    void removeScript(std::string const& path);
    void clearScripts();

    /// What the window knows of its own look; empty if there is nothing.
    QByteArray getLook(QString const& part) const;
    void setLook(QString const& part, QByteArray const& look);

private:
    void setScripts(std::vector<std::string> const& paths);

    mutable std::optional<QSettings> _file;
};

} // namespace Velmora
