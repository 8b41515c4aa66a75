#include "settings.h"

#include "files/osAsync.h"

#include <QFile>
#include <QStandardPaths>
#include <QStringList>

#include <algorithm>
#include <exception>

namespace Velmora
{

namespace
{

constexpr std::size_t maxScripts = 10;

QString const scriptsKey = QStringLiteral("scripts");

QString getPath()
{
    return QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation) +
           QStringLiteral("/velmora/velmora.ini");
}

std::vector<std::string> readScripts(QSettings const& file)
{
    std::vector<std::string> paths;
    for (QString const& text : file.value(scriptsKey).toStringList())
        paths.push_back(QByteArray::fromPercentEncoding(text.toLatin1()).toStdString());
    return paths;
}

void writeScripts(QSettings& file, std::vector<std::string> const& paths)
{
    QStringList texts;
    for (std::string const& path : paths)
        texts.append(QString::fromLatin1(QByteArray::fromStdString(path).toPercentEncoding("/ ")));
    file.setValue(scriptsKey, texts);
    file.sync();
}

void removeFrom(std::vector<std::string>& paths, std::string const& path)
{
    paths.erase(std::remove(paths.begin(), paths.end(), path), paths.end());
}

} // namespace

template <typename Act> auto Settings::makeWork(Act act) const
{
    return [file = _file, path = _path, act]
    {
        if (!*file)
        {
            file->emplace(QFile::decodeName(path.c_str()), QSettings::IniFormat);
            // Else the loop of a thread would write it as well.
            (*file)->moveToThread(nullptr);
        }
        return act(**file);
    };
}

Settings::Settings(bool remembers) : _path(QFile::encodeName(getPath()).toStdString())
{
    if (!remembers)
        return;
    _file = std::make_shared<File>();
    Kv::OsAsync::entrust(_path, makeWork([](QSettings&) {})).wait_for(Kv::OsAsync::longPatience);
}

Settings::~Settings()
{
    try
    {
        if (_file)
            Kv::OsAsync::entrust(_path, makeWork([](QSettings& file) { file.sync(); }))
                .wait_for(Kv::OsAsync::longPatience);
    }
    catch (std::exception const&)
    {
        // Not remembered.
    }
}

std::vector<std::string> Settings::getScripts() const
{
    if (!_file)
        return {};
    auto const read = [](QSettings& file)
    {
        // Another application may have run one meanwhile.
        file.sync();
        return readScripts(file);
    };
    if (auto const paths = Kv::OsAsync::ask(_path, makeWork(read)))
        _scripts = *paths;
    return _scripts;
}

void Settings::addScript(std::string const& path)
{
    changeScripts(
        [path](std::vector<std::string>& paths)
        {
            removeFrom(paths, path);
            paths.insert(paths.begin(), path);
            paths.resize(std::min(paths.size(), maxScripts));
        });
}

void Settings::removeScript(std::string const& path)
{
    changeScripts([path](std::vector<std::string>& paths) { removeFrom(paths, path); });
}

void Settings::clearScripts()
{
    changeScripts([](std::vector<std::string>& paths) { paths.clear(); });
}

QByteArray Settings::getLook(QString const& part) const
{
    if (!_file)
        return {};
    auto const read = [part](QSettings const& file) { return file.value(part).toByteArray(); };
    return Kv::OsAsync::ask(_path, makeWork(read)).value_or(QByteArray());
}

void Settings::setLook(QString const& part, QByteArray const& look)
{
    if (_file)
        Kv::OsAsync::entrust(_path, makeWork([part, look](QSettings& file) { file.setValue(part, look); }));
}

void Settings::changeScripts(std::function<void(std::vector<std::string>&)> const& change)
{
    if (!_file)
        return;
    change(_scripts);
    auto const write = [change](QSettings& file)
    {
        file.sync();
        std::vector<std::string> paths = readScripts(file);
        change(paths);
        writeScripts(file, paths);
    };
    Kv::OsAsync::entrust(_path, makeWork(write));
}

} // namespace Velmora
