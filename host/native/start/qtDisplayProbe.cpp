#include "start/qtDisplayProbe.h"

#include <QCoreApplication>
#include <QDir>
#include <QFile>
#include <QJsonArray>
#include <QJsonObject>
#include <QPluginLoader>
#include <QStringList>

#include <array>
#include <cstring>
#include <poll.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>
#include <xcb/xcb.h>

namespace Kv
{

namespace
{

constexpr char const* remedy = "; set DISPLAY or WAYLAND_DISPLAY to a running display, or QT_QPA_PLATFORM=offscreen to "
                               "run without one";

std::string quoted(QString const& text)
{
    return "\"" + text.toStdString() + "\"";
}

QString environment(char const* name)
{
    return qEnvironmentVariable(name);
}

/// Name of the platform, without the parameters behind it.
QString nameOf(QString const& platform)
{
    return platform.section(QLatin1Char(':'), 0, 0).toLower();
}

/// The folders in which Qt will look for platform plugins.
QStringList pluginFolders()
{
    QStringList folders;
    QString const own = environment("QT_QPA_PLATFORM_PLUGIN_PATH");
    if (!own.isEmpty())
        folders << own;
    // A copy of the list would be taken without asking whether there is memory for it.
    QStringList const paths = QCoreApplication::libraryPaths();
    for (QString const& path : paths)
        folders << path + QStringLiteral("/platforms");
    return folders;
}

/// An open file that is closed in the end.
class Descriptor
{
public:
    explicit Descriptor(int number) : _number(number) {}
    Descriptor(Descriptor const&) = delete;
    Descriptor& operator=(Descriptor const&) = delete;
    ~Descriptor() { ::close(_number); }

    int get() const { return _number; }

private:
    int _number;
};

/// True if what answers there is a compositor: Qt waits for that without an end.
bool answersSync(int connection)
{
    // Wayland's first object has the number 1, is asked by operation 0 to answer to another one, and takes 12 bytes for
    // it.
    constexpr quint32 size = 12;
    constexpr std::array<quint32, 3> sync{1, size << 16U, 2};
    if (::send(connection, sync.data(), size, MSG_NOSIGNAL) != size)
        return false;
    constexpr int patience = 5000;
    pollfd answer{connection, POLLIN, 0};
    quint32 object = 0;
    return ::poll(&answer, 1, patience) == 1 && ::recv(connection, &object, sizeof object, 0) == sizeof object &&
           object == sync.back();
}

bool connects(std::string const& socketPath)
{
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    if (socketPath.size() >= sizeof address.sun_path)
        return false;
    std::memcpy(address.sun_path, socketPath.c_str(), socketPath.size() + 1);
    Descriptor const socket(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0));
    return ::connect(socket.get(), reinterpret_cast<sockaddr const*>(&address), sizeof address) == 0 &&
           answersSync(socket.get());
}

/// True if a number names a connected socket of this process. More cannot be asked: it is for one client alone.
bool isConnection(QString const& number)
{
    bool isNumber = false;
    int const descriptor = number.toInt(&isNumber);
    sockaddr_storage peer{};
    socklen_t size = sizeof peer;
    return isNumber && ::getpeername(descriptor, reinterpret_cast<sockaddr*>(&peer), &size) == 0;
}

/// By the rules of Wayland's own library, which does not look further than the first that is set.
bool answersWayland(std::string& refusal)
{
    if (qEnvironmentVariableIsSet("WAYLAND_SOCKET"))
    {
        QString const number = environment("WAYLAND_SOCKET");
        refusal = "WAYLAND_SOCKET is " + quoted(number) + ", which is no connection";
        return isConnection(number);
    }
    QString const display = qEnvironmentVariable("WAYLAND_DISPLAY", QStringLiteral("wayland-0"));
    QString const path = QDir(environment("XDG_RUNTIME_DIR")).filePath(display);
    refusal = "the Wayland display " + quoted(display) + " cannot be opened";
    return QDir::isAbsolutePath(path) && connects(QFile::encodeName(path).toStdString());
}

bool canOpen(QString const& device, std::string& refusal)
{
    if (::access(device.toLocal8Bit().constData(), R_OK | W_OK) == 0)
        return true;
    refusal = "the device " + quoted(device) + " cannot be opened";
    return false;
}

bool answersGraphicsCard(std::string& refusal)
{
    QDir const cards(QStringLiteral("/dev/dri"), QStringLiteral("card*"), QDir::Name, QDir::System);
    for (QString const& card : cards.entryList())
        if (canOpen(cards.filePath(card), refusal))
            return true;
    refusal = "there is no graphics card that can be opened";
    return false;
}

/// The frame buffer that the parameters of the platform name, or the usual one.
bool answersFrameBuffer(QString const& platform, std::string& refusal)
{
    for (QString const& parameter : platform.split(QLatin1Char(':')))
        if (parameter.startsWith(QLatin1String("fb=")))
            return canOpen(parameter.mid(3), refusal);
    return canOpen(QStringLiteral("/dev/fb0"), refusal);
}

} // namespace

QtDisplayProbe::QtDisplayProbe()
{
    for (QString const& folder : pluginFolders())
        for (QFileInfo const& file : QDir(folder).entryInfoList(QDir::Files))
        {
            QJsonObject const description =
                QPluginLoader(file.filePath()).metaData().value(QLatin1String("MetaData")).toObject();
            for (auto const& key : description.value(QLatin1String("Keys")).toArray())
            {
                QString const name = key.toString().toLower();
                if (!_plugins.contains(name))
                    _plugins.insert(name, file.filePath());
            }
        }
}

DisplayChoice QtDisplayProbe::choose()
{
    QString const asked = environment("QT_QPA_PLATFORM");
    return asked.isEmpty() ? chooseAnswering() : chooseAsked(asked);
}

bool QtDisplayProbe::canLoad(QString const& name, std::string& refusal) const
{
    auto const plugin = _plugins.constFind(name);
    if (plugin == _plugins.constEnd())
    {
        refusal = "there is no platform " + quoted(name) + ", there are " +
                  QStringList(_plugins.keys()).join(QStringLiteral(", ")).toStdString();
        return false;
    }
    QPluginLoader loader(*plugin);
    if (loader.load())
        return true;
    refusal = "the platform " + quoted(name) + " cannot be loaded: " + loader.errorString().toStdString();
    return false;
}

DisplayChoice QtDisplayProbe::chooseAsked(QString const& asked)
{
    std::string refusals;
    for (QString const& platform : asked.split(QLatin1Char(';'), Qt::SkipEmptyParts))
    {
        std::string refusal;
        if (isUsable(platform, refusal))
            return {platform, {}};
        refusals += (refusals.empty() ? "" : "; ") + refusal;
    }
    if (refusals.empty())
        refusals = "that names no platform";
    return {{}, "there is no display: QT_QPA_PLATFORM is " + quoted(asked) + ", but " + refusals + remedy};
}

DisplayChoice QtDisplayProbe::chooseAnswering()
{
    std::string noWayland;
    if (!environment("WAYLAND_DISPLAY").isEmpty() && isUsable(QStringLiteral("wayland"), noWayland))
        return {QStringLiteral("wayland"), {}};
    std::string noX11;
    if (isUsable(QStringLiteral("xcb"), noX11))
        return {QStringLiteral("xcb"), {}};
    return {{}, "there is no display: " + (noWayland.empty() ? "" : noWayland + "; ") + noX11 + remedy};
}

bool QtDisplayProbe::isUsable(QString const& platform, std::string& refusal)
{
    return canLoad(nameOf(platform), refusal) && answers(platform, refusal);
}

bool QtDisplayProbe::answers(QString const& platform, std::string& refusal)
{
    QString const name = nameOf(platform);
    if (name == QLatin1String("xcb"))
        return answersX11(refusal);
    if (name.startsWith(QLatin1String("wayland")))
        return answersWayland(refusal);
    if (name == QLatin1String("linuxfb"))
        return answersFrameBuffer(platform, refusal);
    if (name == QLatin1String("eglfs") || name == QLatin1String("minimalegl") || name == QLatin1String("vkkhrdisplay"))
        return answersGraphicsCard(refusal);
    return true;
}

bool QtDisplayProbe::answersX11(std::string& refusal)
{
    QString const display = environment("DISPLAY");
    if (display.isEmpty())
    {
        refusal = "DISPLAY is not set";
        return false;
    }
    _display.reset(xcb_connect(nullptr, nullptr), &xcb_disconnect);
    if (!xcb_connection_has_error(_display.get()))
        return true;
    refusal = "DISPLAY " + quoted(display) + " cannot be opened";
    return false;
}

} // namespace Kv
