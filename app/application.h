#pragma once

#include "busyWatch.h"
#include "commandLine.h"
#include "interpreter.h"
#include "mainWindow.h"
#include "recovery.h"
#include "scriptOutput.h"
#include "settings.h"

#include "brBrowser.h"
#include "piWidget.h"
#include "uiCompositionWorkspace.h"
#include "uiMainWindow.h"

#include <QTimer>

#include <atomic>
#include <memory>
#include <mutex>
#include <optional>

namespace Velmora
{

/// The running application: what its window shows, and what its commands do.
class Application final
{
public:
    /// The interpreter and the output outlive it. What is remembered of former runs is used only where this one is
    /// remembered too. Throws `Kv::ExBase` with words where windows cannot be shown.
    Application(Interpreter& interpreter, ScriptOutput& output, bool remembers);
    Application(Application const&) = delete;
    Application& operator=(Application const&) = delete;
    ~Application();

    /// Throws `Kv::ExBase` with words for a file that is no composition.
    void openComposition(std::string const& path);

    /// Shows the window and runs until the user ends it, or until the script ends it where `exit` is set. Gives the
    /// exit status.
    int run(std::optional<ScriptCall> const& script, bool exit);

    /// Writes the changes that are not saved at once, for the next start to offer: the process may end at any moment.
    void keepUnsaved() noexcept { _recovery->keepNow(); }

private:
    using Composition = Kv::RCWeakPtr<const Kv::PiCompositionGraphInterface>;

    Commands makeCommands();
    void makeHost();

    /// Asks what is to become of the changes that former runs have left.
    void offerLeft();
    void tellRefusals(std::vector<std::string> const& refusals);
    /// True unless the user wants to be asked another time.
    bool askAboutLeft(std::vector<Recovery::Left>& left);

    /// Runs a script once the loop has come around, and then ends the application where `exit` is set.
    void startScript(ScriptCall const& script, bool exit);
    int runLoop();
    int runScript(ScriptCall const& script);
    void checkSignals();
    /// True after Ctrl-C.
    bool isInterrupted();
    /// Ctrl-C: the application ends, unless the user wants to keep changes.
    void interrupt();

    /// Both throw nothing, but tell the user what is in the way.
    void openChosen(std::string const& path);
    void startChosen(ScriptCall const& script);
    void runRecentScript(std::string const& path);
    /// For any thread.
    void stopScript();

    /// Asks for a file, beginning at a path; empty if none was chosen.
    std::string askPath(QString const& title, std::string const& place);
    void loadFocused(Kv::EvEvent& event);
    /// Runs the file in focus, if it is a script.
    void runFocused(Kv::EvEvent& event);
    void askComposition();
    void askScript();
    void saveComposition();
    /// Asks first if that would undo what others have written. True if it is saved.
    bool save(Composition const& composition);
    void closeComposition();
    void makeCurrent(int place);
    void step(int places);
    void showBuildInfo();

    /// Asks what is to become of changes that have not been saved. True if they may go.
    bool confirmLoss(std::vector<Composition> const& compositions);
    bool quit();

    /// Does what can fail for reasons that the user has to know.
    bool attempt(std::function<void()> const& action);

    std::vector<Composition> getCompositions() const;
    void showCompositions();
    void showCompositionsLater();

    bool _remembers;
    Settings _settings;
    Interpreter& _interpreter;
    MainWindow _window;
    Kv::RCShdPtr<Kv::UiMainWindow> _hostWindow;
    Kv::RCShdPtr<Kv::BrBrowser> _browser;
    Kv::UiEventCallback<Application> _loadCb;
    Kv::UiEventCallback<Application> _fileCb;
    Kv::RCShdPtr<Kv::UiCompositionWorkspace> _workspace;
    std::optional<Recovery> _recovery;
    QTimer _signalTimer;
    QTimer _showTimer;
    std::optional<ScriptCall> _lastScript;
    std::atomic<bool> _scriptRuns{false};
    std::mutex _stopping;
    bool _stopAsked = false;
    bool _closing = false;
    /// Of the script whose end is that of the application.
    std::optional<int> _exitStatus;
    std::optional<BusyWatch> _watch;
};

} // namespace Velmora
