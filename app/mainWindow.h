#pragma once

#include "compositionPane.h"

#include <QActionGroup>
#include <QLabel>
#include <QMainWindow>

#include <functional>
#include <vector>

namespace Velmora
{

class NodeView;

/// What the user can ask the application for.
struct Commands
{
    std::function<void()> openComposition;
    std::function<void()> saveComposition;
    std::function<void()> closeComposition;
    std::function<void()> runScript;
    std::function<void()> runScriptAgain;
    std::function<void()> showBuildInfo;
    /// By the place among the open ones.
    std::function<void(int)> makeCurrent;
    /// By how many places further among the open ones, around the ends.
    std::function<void(int)> step;
    /// True if the application may end.
    std::function<bool()> quit;
};

/// The window: the file browser, the main panel in which dialogs float, and the compositions. Of the first two it makes
/// only the place.
class MainWindow final : public QMainWindow
{
public:
    explicit MainWindow(Commands commands);

    QWidget* getPanel() const { return _panel; }
    QWidget* getBrowserPlace() const { return _browserPlace; }

    /// Enables and disables all that the window has of its own.
    void setOwnEnabled(bool enabled);

    void showCompositions(std::vector<CompositionEntry> const& entries);

    /// The nodes of the current composition; null for none.
    void showGraph(Kv::RCShdPtr<const Kv::PiGraph> const& graph);

    /// Whether there is a script to be run again.
    void setRunAgainEnabled(bool enabled) { _runAgain->setEnabled(enabled); }

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
    void makePanes();
    void showInMenu(std::vector<CompositionEntry> const& entries);

    Commands _commands;
    QWidget* _panel = nullptr;
    QWidget* _browserPlace = nullptr;
    NodeView* _nodeView = nullptr;
    CompositionPane* _compositions = nullptr;
    QMenu* _compositionMenu = nullptr;
    QAction* _runAgain = nullptr;
    QLabel* _message = nullptr;
    /// Those that need a composition.
    QActionGroup* _onComposition = nullptr;
    QActionGroup* _openOnes = nullptr;
};

} // namespace Velmora
