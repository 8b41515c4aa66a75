#include "start/qtApplication.h"

#include "exBase.h"
#include "files/osAsync.h"
#include "loop/qtGuard.h"
#include "loop/qtWayOut.h"
#include "start/qtDisplayProbe.h"
#include "start/qtDisplayWatch.h"
#include "windows/qtWindowIcon.h"

#include <QApplication>
#include <QByteArray>
#include <QFile>
#include <QStandardPaths>
#include <QThread>
#include <QWidget>

#include <array>
#include <clocale>
#include <cstddef>
#include <new>
#include <sys/mman.h>
#include <unistd.h>

namespace Kv
{

namespace
{

/// Qt sets every category of the C library's locale. Numbers stay as they were: interpreters and parsers of this
/// process count on them.
class NumberLocaleKeeper
{
public:
    NumberLocaleKeeper() : _name(std::setlocale(LC_NUMERIC, nullptr)) {}
    NumberLocaleKeeper(NumberLocaleKeeper const&) = delete;
    NumberLocaleKeeper& operator=(NumberLocaleKeeper const&) = delete;
    ~NumberLocaleKeeper() { (void)std::setlocale(LC_NUMERIC, _name.c_str()); }

private:
    std::string _name;
};

/// Keeps what an event handler throws, of ours or of Qt's own, from the frames of Qt's loop: its timers would never go
/// on.
class GuardedApplication final : public QApplication
{
public:
    using QApplication::QApplication;

    bool notify(QObject* receiver, QEvent* event) override
    {
        try
        {
            return QApplication::notify(receiver, event);
        }
        catch (QtWayOut::Left const&)
        {
            throw;
        }
        catch (...)
        {
            if (QThread::currentThread() != thread())
                throw;
            QtGuard::getInstance().take();
            return false;
        }
    }
};

/// More of the address space than Qt takes as it starts, or for a window: its threads have much set aside. It crashes,
/// or waits for ever, where it does not get all.
void requireMemory()
{
    constexpr std::size_t size = std::size_t(256) << 20;
    void* const block = mmap(nullptr, size, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
    if (block == MAP_FAILED)
        throw std::bad_alloc();
    munmap(block, size);
}

/// Qt and the library of fonts look for files of theirs in the user's folder for settings, and would wait for one that
/// does not answer. In its place they get one that can hold nothing.
void avoidSilentSettings()
{
    QByteArray const folder =
        QFile::encodeName(QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation));
    auto const look = [folder] { return access(folder.constData(), F_OK); };
    if (!OsAsync::ask(folder.toStdString(), look))
        qputenv("XDG_CONFIG_HOME", "/dev/null");
}

/// What ends Qt's own start leaves an application object that is none, and that nobody can take away.
bool isStarting = false;

/// Never destroyed: the last widgets go after everything that could destroy it. The arguments live as long.
QCoreApplication* makeApplication(QString const& platform)
{
    NumberLocaleKeeper const keeper;
    static QByteArray program("velmora");
    static QByteArray option("-platform");
    static QByteArray value;
    value = platform.toLocal8Bit();
    static std::array<char*, 4> arguments{};
    arguments = {program.data(), option.data(), value.data(), nullptr};
    static int count = 0;
    count = static_cast<int>(arguments.size()) - 1;
    isStarting = true;
    auto* const application = new GuardedApplication(count, arguments.data());
    isStarting = false;
    QApplication::setQuitOnLastWindowClosed(false);
    QApplication::setWindowIcon(getWindowIcon());
    return application;
}

/// Deletes a script's application object and its windows at the end of their thread. They cannot outlive that: Qt's own
/// objects of the thread go then, and whoever deletes the others later crashes.
void deleteInItsThread()
{
    QCoreApplication* const application = QCoreApplication::instance();
    if (!application || application->thread() != QThread::currentThread())
        return;
    while (!QApplication::topLevelWidgets().isEmpty())
        delete QApplication::topLevelWidgets().constFirst();
    delete application;
}

bool isMainThread()
{
    return gettid() == getpid();
}

bool isWidgetApplication(QCoreApplication* application)
{
    return qobject_cast<QApplication*>(application);
}

} // namespace

QtApplication::QtApplication()
{
    start();
}

bool QtApplication::isThere()
{
    return QCoreApplication::instance() && !QtDisplayWatch::isForked();
}

bool QtApplication::hasGui()
{
    start();
    return isWidgetApplication(QCoreApplication::instance());
}

bool QtApplication::isOwn() const
{
    return _own && _own == QCoreApplication::instance();
}

void QtApplication::requireLoop()
{
    start();
    if (std::string const loss = QtWayOut::findLoss(); !loss.empty())
        throw ExBase(__FILE__, __LINE__, "Cannot dispatch events: " + loss);
    if (!QCoreApplication::instance())
        throw ExBase(__FILE__, __LINE__, "Cannot dispatch events: " + getRefusal());
    if (QCoreApplication::instance()->thread() != QThread::currentThread())
        throw ExBase(__FILE__, __LINE__, "Cannot dispatch events: this is not the thread of the user interface");
}

void QtApplication::requireWindows()
{
    start();
    QCoreApplication* const application = QCoreApplication::instance();
    if (application && !isWidgetApplication(application))
        throw ExBase(__FILE__, __LINE__,
                     "Cannot show a window: there is a QCoreApplication that is no QApplication; create a QApplication "
                     "instead of it");
    if (!application || (application == _own && !_refusal.empty()))
        throw ExBase(__FILE__, __LINE__, "Cannot show a window: " + getRefusal());
    if (std::string const loss = QtWayOut::findLoss(); !loss.empty())
        throw ExBase(__FILE__, __LINE__, "Cannot show a window: " + loss);
    if (application->thread() != QThread::currentThread())
        throw ExBase(__FILE__, __LINE__, "Cannot show a window: this is not the thread of the user interface");
    requireMemory();
}

void QtApplication::start()
{
    if (isStarting)
        throw ExBase(__FILE__, __LINE__,
                     "Cannot start Qt: it was short of memory when it started in this process; start another one");
    if (!_tried && !QCoreApplication::instance())
        makeOwn();
    if (!isMainThread())
        QtGuard::getInstance().getScriptHook().callAtThreadEnd(&deleteInItsThread);
    if (QtDisplayWatch::watch())
        QtWayOut::watch();
}

std::string QtApplication::getRefusal() const
{
    return _refusal.empty() ? "the QApplication was destroyed, and there is no other" : _refusal;
}

void QtApplication::makeOwn()
{
    // Qt's objects would outlive a thread that ends before the process, and end that.
    if (!isMainThread())
    {
        _refusal = "this is not the main thread, and there is no QApplication; launch dialogs from the main thread";
        return;
    }
    requireMemory();
    avoidSilentSettings();
    _tried = true;
    QtDisplayProbe probe;
    DisplayChoice choice = probe.choose();
    _refusal = choice.refusal;
    // Without a display texts are measured all the same.
    std::string reason;
    if (choice.platform.isEmpty() && probe.canLoad(QStringLiteral("offscreen"), reason))
        choice.platform = QStringLiteral("offscreen");
    if (!choice.platform.isEmpty())
        _own = makeApplication(choice.platform);
}

} // namespace Kv
