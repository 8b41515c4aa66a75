#include "application.h"

#include "buildInfo.h"
#include "pathQuestion.h"
#include "recoveryQuestion.h"

#include "exBase.h"
#include "files/osAsync.h"
#include "files/osFile.h"
#include "pointers/rcWeakPtr.h"
#include "text/liString.h"
#include "uiAppMgr.h"
#include "wsNative.h"

#include <QApplication>
#include <QFileInfo>
#include <QMessageBox>

#include <algorithm>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <sstream>
#include <unistd.h>
#include <utility>

namespace Velmora
{

namespace
{

/// The time between two looks for Ctrl-C while no script runs, in milliseconds.
constexpr int signalInterval = 100;
constexpr int interruptedStatus = 130;

QString toText(std::string const& bytes)
{
    return QString::fromUtf8(bytes.data(), static_cast<qsizetype>(bytes.size()));
}

/// Throws for a file that would keep the window from answering, since its file system does not.
void requireAnswer(std::string const& path)
{
    auto const look = [path]
    { return Kv::OsFileDescriptor(open(path.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC)).isOpen(); };
    if (!Kv::OsAsync::ask(path, look))
        throw Kv::ExBase(__FILE__, __LINE__,
                         "The file system of " + Kv::LiStringUtil::getPrintablePath(path) +
                             " does not answer. Try it later");
}

/// True if somebody can look at the windows.
bool hasScreen()
{
    QString const name = QGuiApplication::platformName();
    return name != QLatin1String("offscreen") && name != QLatin1String("minimal");
}

/// By which other processes know a window; 0 where they cannot.
quint64 getWindowNumber(QWidget const& window)
{
    return QGuiApplication::platformName() == QLatin1String("xcb") ? window.winId() : 0;
}

Kv::UiConstraint makeFilling()
{
    using Kv::UiConstraint;
    auto const edge = [](UiConstraint::Target target) {
        return UiConstraint::Edge{0, UiConstraint::Pixels, target, {}};
    };
    return UiConstraint({edge(UiConstraint::ParentLow), edge(UiConstraint::ParentLow), edge(UiConstraint::ParentHigh),
                         edge(UiConstraint::ParentHigh)});
}

} // namespace

Application::Application(Interpreter& interpreter, ScriptOutput& output, bool remembers)
    : _remembers(remembers), _settings(remembers), _interpreter(interpreter), _window(makeCommands(), output),
      _loadCb(this, &Application::loadFocused), _fileCb(this, &Application::runFocused)
{
    _interpreter.attempt([&output] { output.tapStreams(); });
    _window.restoreLook(_settings);
    makeHost();
    _showTimer.setSingleShot(true);
    QObject::connect(&_showTimer, &QTimer::timeout, &_window, [this] { showCompositions(); });
    QObject::connect(&_signalTimer, &QTimer::timeout, &_window, [this] { checkSignals(); });
    showCompositions();
}

Application::~Application()
{
    _watch.reset();
    _workspace->setChangeCallback(nullptr);
    Kv::UiWorkspace::setCurrentWorkspace(nullptr);
    Kv::UiAppMgr::getInstance().setApplication(nullptr, nullptr, nullptr);
}

void Application::openComposition(std::string const& path)
{
    _workspace->open(Kv::OsFilePath(path));
}

int Application::run(std::optional<ScriptCall> const& script, bool exit)
{
    _hostWindow->show();
    _hostWindow->getRootContainer()->setFocusWidget(_browser);
    QTimer::singleShot(0, &_window,
                       [this, script, exit]
                       {
                           if (_remembers && hasScreen())
                               offerLeft();
                           if (script)
                               startScript(*script, exit);
                       });
    _signalTimer.start(signalInterval);
    if (hasScreen())
        _watch.emplace([this] { return _scriptRuns || _interpreter.isRunning(); }, [this] { stopScript(); });
    int const status = runLoop();
    _watch.reset();
    if (!Kv::WsNative::getPlatform().hasDisplay())
        return status;
    _signalTimer.stop();
    _recovery->discard();
    _window.saveLook(_settings);
    // The scripts' own acts at the end can open no dialog any more: nobody would see it.
    Kv::WsNative::getPlatform().closeLoops();
    return status;
}

int Application::runLoop()
{
    try
    {
        return Kv::WsNative::getPlatform().runApplication([this] { keepUnsaved(); });
    }
    catch (Kv::ExBase const&)
    {
        _recovery->leave();
        // There is no display any more. What a script has come to before that counts.
        if (!_exitStatus)
            throw;
        return *_exitStatus;
    }
}

Commands Application::makeCommands()
{
    Commands commands;
    commands.openComposition = [this] { askComposition(); };
    commands.saveComposition = [this] { saveComposition(); };
    commands.closeComposition = [this] { closeComposition(); };
    commands.runScript = [this] { askScript(); };
    commands.runScriptAgain = [this] { startChosen(*_lastScript); };
    commands.getRecentScripts = [this] { return _settings.getScripts(); };
    commands.runRecentScript = [this](std::string const& path) { runRecentScript(path); };
    commands.forgetRecentScripts = [this] { _settings.clearScripts(); };
    commands.stopScript = [this]
    {
        stopScript();
        Kv::WsNative::getPlatform().interruptLoop();
    };
    commands.goToBrowser = [this] { _hostWindow->getRootContainer()->setFocusWidget(_browser); };
    commands.showBuildInfo = [this] { showBuildInfo(); };
    commands.makeCurrent = [this](int place) { makeCurrent(place); };
    commands.step = [this](int places) { step(places); };
    commands.quit = [this] { return quit(); };
    return commands;
}

void Application::makeHost()
{
    using namespace Kv;
    _hostWindow = UiMainWindow::create("Velmora", "Velmora", NtForeignWidget{&_window},
                                       [this](bool enabled) { _window.setOwnEnabled(enabled); });
    RCShdPtr<UiContainer> const root = _hostWindow->getRootContainer();
    RCShdPtr<UiPanel> const panel = UiPanel::create(root, "mainPanel", NtForeignWidget{_window.getPanel()});
    RCShdPtr<UiPanel> const place = UiPanel::create(root, "browserPanel", NtForeignWidget{_window.getBrowserPlace()});
    _browser = BrBrowser::create(place, "Browser", nullptr);
    _browser->setConstraint(makeFilling());
    _browser->setMultiple(true);
    _browser->setLoadCb(&_loadCb);
    _browser->getPiWidget()->addCallback(PiWidget::Activate, &_fileCb);
    _browser->setKeyboardFocusable(true);
    // Where that is gone the browser stays at the root.
    std::error_code nowhere;
    _browser->setURL(std::filesystem::current_path(nowhere).string(), HistoryEnum(0), UpdateEnum(0));
    _workspace = makeShd<UiCompositionWorkspace>([this] { return _hostWindow->findWidgetWithKeyboard(); });
    _recovery.emplace(*_workspace,
                      [this](QString const& words)
                      {
                          _window.note(words);
                          _window.tell(words);
                      });
    _workspace->setChangeCallback(
        [this]
        {
            _recovery->follow();
            showCompositionsLater();
        });
    UiWorkspace::setCurrentWorkspace(_workspace);
    UiAppMgr::getInstance().setApplication(_hostWindow, panel, _browser->getView());
}

void Application::offerLeft()
{
    Recovery::Findings findings = _recovery->find();
    if (!findings.refusals.empty())
        tellRefusals(findings.refusals);
    while (!findings.left.empty() && askAboutLeft(findings.left))
        ;
}

void Application::tellRefusals(std::vector<std::string> const& refusals)
{
    QString words;
    for (std::string const& refusal : refusals)
    {
        _window.note(QObject::tr("Changes that were not saved cannot be read: %1").arg(toText(refusal)));
        words += QStringLiteral("\n\n") + toText(refusal);
    }
    QMessageBox box(QMessageBox::Warning, QObject::tr("Changes That Cannot Be Read"),
                    QObject::tr("Changes that were not saved cannot be read. Their files are kept:") + words,
                    QMessageBox::Close, &_window);
    box.setTextFormat(Qt::PlainText);
    box.exec();
    _window.activateWindow();
}

bool Application::askAboutLeft(std::vector<Recovery::Left>& left)
{
    RecoveryQuestion question(&_window, left);
    int const answer = question.exec();
    _window.activateWindow();
    if (answer == RecoveryQuestion::Later)
        return false;
    std::vector<std::size_t> const selected = question.getSelected();
    std::vector<Recovery::Left> rest;
    for (std::size_t place = 0; place < left.size(); ++place)
    {
        bool isDone = std::binary_search(selected.begin(), selected.end(), place);
        if (isDone && answer == RecoveryQuestion::ThrowAway)
            _recovery->throwAway(left[place]);
        else if (isDone)
            isDone = attempt([&] { _recovery->restore(left[place]); });
        if (!isDone)
            rest.push_back(std::move(left[place]));
    }
    left = std::move(rest);
    return true;
}

void Application::startScript(ScriptCall const& script, bool exit)
{
    // Later: what asked for it, a menu for one, has first to give the keyboard back.
    QTimer::singleShot(0, &_window,
                       [this, script, exit]
                       {
                           int const status = runScript(script);
                           if (!exit && !_closing)
                               return;
                           _exitStatus = status;
                           QApplication::exit(status);
                       });
}

int Application::runScript(ScriptCall const& script)
{
    if (_scriptRuns)
    {
        _window.tell(QObject::tr("A script is running already"));
        return 1;
    }
    _scriptRuns = true;
    _lastScript = script;
    if (script.kind == ScriptCall::Kind::File)
        _settings.addScript(script.target);
    QString const name = QFileInfo(toText(script.target)).fileName();
    if (_watch)
        _watch->setOffer({name.toStdString(), _window.frameGeometry().center(), getWindowNumber(_window)});
    _window.setRunning(true);
    _window.tell(QObject::tr("%1 is running").arg(name));
    _window.note(QObject::tr("%1 is running").arg(name));
    _window.paintNow();
    pid_t const self = getpid();
    int status = 0;
    Kv::WsNative::getPlatform().callScript([&] { status = _interpreter.run(script); });
    // The window and all else is the other one's.
    if (getpid() != self)
        std::exit(status); // NOLINT(concurrency-mt-unsafe): a forked process has one thread
    _scriptRuns = false;
    checkSignals();
    _window.setRunning(false);
    std::string const& failure = _interpreter.getFailure();
    QString outcome = QObject::tr("%1 has ended").arg(name);
    if (!failure.empty())
        outcome = status == interruptedStatus
                      ? QObject::tr("%1 was stopped").arg(name)
                      : QObject::tr("%1 has failed: %2").arg(name, toText(failure).simplified());
    _window.tell(outcome);
    _window.note(outcome);
    return status;
}

void Application::checkSignals()
{
    if (_watch)
        _watch->turn();
    // A script that runs hears of its signals itself.
    if (!_scriptRuns && isInterrupted())
        interrupt();
}

bool Application::isInterrupted()
{
    std::lock_guard<std::mutex> const lock(_stopping);
    // A stop that comes after the script's end stops nothing else.
    bool const isLate = std::exchange(_stopAsked, false);
    return _interpreter.isInterrupted() && !isLate;
}

void Application::stopScript()
{
    std::lock_guard<std::mutex> const lock(_stopping);
    _stopAsked = true;
    _interpreter.stop();
}

std::string Application::askPath(QString const& title, std::string const& place)
{
    std::string path;
    auto const ask = [&] { path = PathQuestion(title.toUtf8().constData(), place).ask(); };
    bool answered = true;
    attempt([&] { answered = _interpreter.attempt(ask); });
    if (!answered)
        interrupt();
    return path;
}

void Application::interrupt()
{
    // A second Ctrl-C, while the user is asked about changes, is meant.
    bool const isAsking = QApplication::activeModalWidget();
    if (isAsking)
        _recovery->leave();
    if (isAsking || confirmLoss(getCompositions()))
        QApplication::exit(interruptedStatus);
}

void Application::loadFocused(Kv::EvEvent&)
{
    // Later: what goes wrong is told in a box, for which nobody shall wait.
    std::string const path = _browser->getInputFocusPath().toString();
    QMetaObject::invokeMethod(
        &_window, [this, path] { openChosen(path); }, Qt::QueuedConnection);
}

void Application::runFocused(Kv::EvEvent&)
{
    std::filesystem::path const path = _browser->getInputFocusPath().toString();
    if (Kv::BrBrowser::isScript(path.filename()))
        startChosen(ScriptCall::makeFile(path, {}));
    else
        _window.tell(QObject::tr("%1 is neither a composition nor a script").arg(toText(path.filename())));
}

void Application::askComposition()
{
    std::string const path = askPath(QObject::tr("Open Composition"), _browser->getPath().toString());
    if (!path.empty())
        openChosen(path);
}

void Application::openChosen(std::string const& path)
{
    attempt(
        [&]
        {
            requireAnswer(path);
            openComposition(path);
        });
}

void Application::askScript()
{
    std::vector<std::string> const recent = _settings.getScripts();
    std::string const last = recent.empty() ? "" : std::filesystem::path(recent.front()).parent_path();
    bool const isThere = Kv::OsFsUtils::findKind(Kv::OsFilePath(last)) == std::filesystem::file_type::directory;
    std::string const path = askPath(QObject::tr("Run Script"), isThere ? last : _browser->getPath().toString());
    if (!path.empty())
        startChosen(ScriptCall::makeFile(path, {}));
}

void Application::startChosen(ScriptCall const& script)
{
    attempt(
        [&]
        {
            if (script.kind == ScriptCall::Kind::File)
                requireAnswer(script.target);
            startScript(script, false);
        });
}

void Application::runRecentScript(std::string const& path)
{
    if (Kv::OsFsUtils::fileExists(Kv::OsFilePath(path)))
    {
        startChosen(ScriptCall::makeFile(path, {}));
        return;
    }
    _settings.removeScript(path);
    _window.tell(QObject::tr("%1 is not there any more").arg(toText(path)));
}

void Application::saveComposition()
{
    Composition const current = _workspace->getCurrentComposition();
    Kv::RCWeakAccessor<const Kv::PiCompositionGraphInterface> const composition(current);
    if (composition.isNull())
        return;
    QString const name = toText(composition->getGraph()->getName());
    if (!composition->isModified())
        _window.tell(QObject::tr("%1 has no changes to save").arg(name));
    else if (save(current))
        _window.tell(QObject::tr("%1 is saved").arg(name));
}

bool Application::save(Composition const& composition)
{
    Kv::RCWeakAccessor<const Kv::PiCompositionGraphInterface> const accessor(composition);
    if (!attempt([&] { requireAnswer(accessor->getPath().toString()); }))
        return false;
    if (!accessor->isChangedOnDisk())
        return attempt([&] { _workspace->save(composition); });
    QMessageBox box(QMessageBox::Warning, QObject::tr("Velmora"),
                    QObject::tr("%1 has been changed on disk since it was opened. Save over these changes?")
                        .arg(toText(accessor->getGraph()->getName())),
                    QMessageBox::Save | QMessageBox::Cancel, &_window);
    box.setDefaultButton(QMessageBox::Cancel);
    box.setTextFormat(Qt::PlainText);
    int const answer = box.exec();
    _window.activateWindow();
    return answer == QMessageBox::Save && attempt([&] { _workspace->saveOver(composition); });
}

void Application::closeComposition()
{
    Composition const current = _workspace->getCurrentComposition();
    if (!current.isExpired() && confirmLoss({current}))
        attempt([&] { _workspace->close(current); });
}

void Application::makeCurrent(int place)
{
    std::vector<Composition> const compositions = getCompositions();
    if (place >= 0 && place < static_cast<int>(compositions.size()))
        _workspace->makeCurrent(compositions[static_cast<std::size_t>(place)]);
}

void Application::step(int places)
{
    std::vector<Composition> const compositions = getCompositions();
    auto const count = static_cast<int>(compositions.size());
    Composition const current = _workspace->getCurrentComposition();
    auto const found = std::find_if(compositions.begin(), compositions.end(),
                                    [&](Composition const& other) { return other == current; });
    if (found != compositions.end())
        makeCurrent((static_cast<int>(found - compositions.begin()) + places + count) % count);
}

void Application::showBuildInfo()
{
    std::ostringstream text;
    writeBuildInfo(text);
    _window.showText(QObject::tr("Build Information"), toText(text.str()));
}

bool Application::confirmLoss(std::vector<Composition> const& compositions)
{
    for (Composition const& composition : compositions)
    {
        Kv::RCWeakAccessor<const Kv::PiCompositionGraphInterface> const accessor(composition);
        if (accessor.isNull() || !accessor->isModified())
            continue;
        QString const name = toText(accessor->getGraph()->getName());
        QMessageBox box(QMessageBox::Question, QObject::tr("Velmora"),
                        QObject::tr("%1 has changes that are not saved.").arg(name),
                        QMessageBox::Save | QMessageBox::Discard | QMessageBox::Cancel, &_window);
        box.setDefaultButton(QMessageBox::Save);
        box.setTextFormat(Qt::PlainText);
        int const answer = box.exec();
        _window.activateWindow();
        bool const isSaved = answer == QMessageBox::Save && save(composition);
        if (!isSaved && answer != QMessageBox::Discard)
            return false;
    }
    return true;
}

bool Application::quit()
{
    if (!_closing && !confirmLoss(getCompositions()))
        return false;
    _closing = true;
    _window.hide();
    // A script that runs comes to its end first, with its dialogs ended.
    Kv::WsNative::getPlatform().closeLoops();
    if (!_scriptRuns)
        QApplication::exit(0);
    return true;
}

bool Application::attempt(std::function<void()> const& action)
{
    try
    {
        action();
        return true;
    }
    catch (std::exception const& error)
    {
        QMessageBox box(QMessageBox::Warning, QObject::tr("Velmora"), toText(error.what()), QMessageBox::Close,
                        &_window);
        box.setTextFormat(Qt::PlainText);
        box.exec();
        _window.activateWindow();
        return false;
    }
}

std::vector<Application::Composition> Application::getCompositions() const
{
    std::vector<Composition> compositions;
    for (auto iterator = _workspace->getCompositions(); !iterator.atEnd(); ++iterator)
        compositions.push_back(*iterator);
    return compositions;
}

void Application::showCompositions()
{
    Composition const current = _workspace->getCurrentComposition();
    std::vector<CompositionEntry> entries;
    for (Composition const& composition : getCompositions())
    {
        Kv::RCWeakAccessor<const Kv::PiCompositionGraphInterface> const accessor(composition);
        if (accessor.isNull())
            continue;
        // One whose file system does not answer cannot be written now.
        std::string const path = accessor->getPath().toString();
        auto const look = [path] { return Kv::OsFile(Kv::OsFilePath(path)).isWritable(); };
        entries.push_back({toText(accessor->getGraph()->getName()), toText(path), composition == current,
                           Kv::OsAsync::ask(path, look).value_or(false), accessor->isModified()});
    }
    _window.showCompositions(entries);
    Kv::RCWeakAccessor<const Kv::PiCompositionGraphInterface> const accessor(current);
    _window.showGraph(accessor.isNull() ? nullptr : accessor->getGraph());
}

void Application::showCompositionsLater()
{
    // Once for all that a script does at a stretch.
    if (!_showTimer.isActive())
        _showTimer.start(0);
}

} // namespace Velmora
