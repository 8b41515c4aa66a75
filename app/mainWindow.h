#pragma once

#include "compositionPane.h"
#include "logPane.h"

#include <QActionGroup>
#include <QLabel>
#include <QMainWindow>
#include <QSplitter>

#include <functional>
#include <vector>

namespace Velmora
{

class NodeView;
class Settings;

/// The commands that the user can give to the application.
struct Commands
{
    std::function<void()> openComposition;
    std::function<void()> saveComposition;
    std::function<void()> closeComposition;
    std::function<void()> runScript;
    std::function<void()> runScriptAgain;
    /// The scripts that ran last, by their paths, and to run one of them.
    std::function<std::vector<std::string>()> getRecentScripts;
    std::function<void(std::string const&)> runRecentScript;
    std::function<void()> forgetRecentScripts;
    std::function<void()> stopScript;
    std::function<void()> goToBrowser;
    std::function<void()> showBuildInfo;
    /// By the place among the open ones.
    std::function<void(int)> makeCurrent;
    /// By how many places further among the open ones, around the ends.
    std::function<void(int)> step;
    /// True if the application may end.
    std::function<bool()> quit;
};

/// The window: the file browser, the main panel in which dialogs float, the compositions, and the log. Of the first two
/// it makes only the place.
class MainWindow final : public QMainWindow
{
public:
    /// `output`, borrowed, is what the log shows.
    MainWindow(Commands commands, ScriptOutput& output);

    QWidget* getPanel() const { return _panel; }
    QWidget* getBrowserPlace() const { return _browserPlace; }

    /// Enables and disables all that the window has of its own, but that a script can be stopped and the log scrolled.
    void setOwnEnabled(bool enabled);

    /// Takes the size of the window and of its parts from one run to the next.
    void restoreLook(Settings const& settings);
    void saveLook(Settings& settings) const;

    void showCompositions(std::vector<CompositionEntry> const& entries);

    /// The nodes of the current composition; null for none.
    void showGraph(Kv::RCShdPtr<const Kv::PiGraph> const& graph);

    /// Says if a script runs, which then can be stopped, and afterwards be run again.
    void setRunning(bool running);

    /// Says something of a script in the log.
    void note(QString const& text) { _log->note(text); }

    /// Says something in the line at the bottom, until the next.
    void tell(QString const& text);

    /// Shows lines of text in a window of their own, until the user closes it.
    void showText(QString const& title, QString const& text);

    /// Brings the window up to date on the screen, before something that takes its time.
    void paintNow();

protected:
    void closeEvent(QCloseEvent* event) override;

private:
    void makeMenus();
    void makeScriptMenu();
    void makeViewMenu();
    void makePanes(ScriptOutput& output);
    void showRecentScripts(QMenu& menu);
    void showLog(bool shown);
    /// Gives the keyboard to the uppermost of the dialogs that float in the main panel.
    void goToDialog();
    void showInMenu(std::vector<CompositionEntry> const& entries);

    Commands _commands;
    QWidget* _panel = nullptr;
    QWidget* _browserPlace = nullptr;
    NodeView* _nodeView = nullptr;
    CompositionPane* _compositions = nullptr;
    LogPane* _log = nullptr;
    QSplitter* _columns = nullptr;
    QSplitter* _rows = nullptr;
    QMenu* _compositionMenu = nullptr;
    QAction* _runAgain = nullptr;
    QAction* _stop = nullptr;
    QAction* _showsLog = nullptr;
    QLabel* _message = nullptr;
    /// Those that are not there while a dialog runs.
    QActionGroup* _own = nullptr;
    /// Those that need a composition.
    QActionGroup* _onComposition = nullptr;
    QActionGroup* _openOnes = nullptr;
};

} // namespace Velmora
