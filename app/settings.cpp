#include "settings.h"

#include <QStandardPaths>
#include <QStringList>

#include <algorithm>

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

} // namespace

Settings::Settings(bool remembers)
{
    if (remembers)
        _file.emplace(getPath(), QSettings::IniFormat);
}

std::vector<std::string> Settings::getScripts() const
{
    std::vector<std::string> paths;
    if (!_file)
        return paths;
    // Another application may have run one meanwhile.
    _file->sync();
    for (QString const& text : _file->value(scriptsKey).toStringList())
        paths.push_back(QByteArray::fromPercentEncoding(text.toLatin1()).toStdString());
    return paths;
}

void Settings::addScript(std::string const& path)
{
    std::vector<std::string> paths = getScripts();
    paths.erase(std::remove(paths.begin(), paths.end(), path), paths.end());
    paths.insert(paths.begin(), path);
    paths.resize(std::min(paths.size(), maxScripts));
    setScripts(paths);
}

void Settings::removeScript(std::string const& path)
{
    std::vector<std::string> paths = getScripts();
    paths.erase(std::remove(paths.begin(), paths.end(), path), paths.end());
    setScripts(paths);
}

void Settings::clearScripts()
{
    setScripts({});
}

QByteArray Settings::getLook(QString const& part) const
{
    return _file ? _file->value(part).toByteArray() : QByteArray();
}

void Settings::setLook(QString const& part, QByteArray const& look)
{
    if (_file)
        _file->setValue(part, look);
}

void Settings::setScripts(std::vector<std::string> const& paths)
{
    if (!_file)
        return;
    QStringList texts;
    for (std::string const& path : paths)
        texts.append(QString::fromLatin1(QByteArray::fromStdString(path).toPercentEncoding("/ ")));
    _file->setValue(scriptsKey, texts);
}

} // namespace Velmora
