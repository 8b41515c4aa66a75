#include "mainWindow.h"

#include "nodeView.h"
#include "settings.h"

#include <QApplication>
#include <QCloseEvent>
#include <QDialog>
#include <QDialogButtonBox>
#include <QDir>
#include <QElapsedTimer>
#include <QFileInfo>
#include <QFontDatabase>
#include <QMenuBar>
#include <QPlainTextEdit>
#include <QScreen>
#include <QStatusBar>
#include <QTextDocument>
#include <QVBoxLayout>
#include <QWindow>

#include <algorithm>
#include <utility>

namespace Velmora
{

namespace
{

constexpr QSize windowSize(1180, 760);

/// Of the window's height, in percent.
constexpr int logShare = 24;

/// The frame that a window manager adds, which is known only when it is too late.
constexpr QSize windowFrame(8, 40);

/// The greatest width of a script's folder in a menu.
constexpr int menuWidth = 360;

QString const windowKey = QStringLiteral("window");
QString const columnsKey = QStringLiteral("columns");
QString const rowsKey = QStringLiteral("rows");
QString const logKey = QStringLiteral("log");
QByteArray const hiddenLook = QByteArrayLiteral("hidden");

/// A text for a menu, in which each ampersand stands for itself.
QString withoutShortcuts(QString text)
{
    return text.replace(QLatin1Char('&'), QLatin1String("&&"));
}

QAction* addCommand(QMenu& menu, QString const& text, QKeySequence const& keys, std::function<void()> const& run)
{
    QAction* const action = menu.addAction(text, keys, &menu, run);
    action->setMenuRole(QAction::NoRole);
    return action;
}

} // namespace

MainWindow::MainWindow(Commands commands, ScriptOutput& output) : _commands(std::move(commands))
{
    setObjectName(QStringLiteral("Velmora"));
    setWindowTitle(QStringLiteral("Velmora"));
    // Empty where there is no screen for now.
    QSize const room = screen()->availableGeometry().size() - windowFrame;
    resize(room.isEmpty() ? windowSize : windowSize.boundedTo(room));
    makePanes(output);
    makeMenus();
    _message = new QLabel;
    _message->setObjectName(QStringLiteral("message"));
    _message->setTextFormat(Qt::PlainText);
    // As wide as there is room, whatever it says.
    _message->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Preferred);
    statusBar()->addWidget(_message, 1);
    tell(tr("Ready"));
}

void MainWindow::setOwnEnabled(bool enabled)
{
    _own->setEnabled(enabled);
    _browserPlace->setEnabled(enabled);
    _nodeView->setEnabled(enabled);
    _compositions->setEnabled(enabled);
    _log->setUsable(enabled);
    statusBar()->setEnabled(enabled);
}

void MainWindow::restoreLook(Settings const& settings)
{
    restoreGeometry(settings.getLook(windowKey));
    _columns->restoreState(settings.getLook(columnsKey));
    _rows->restoreState(settings.getLook(rowsKey));
    _showsLog->setChecked(settings.getLook(logKey) != hiddenLook);
}

void MainWindow::saveLook(Settings& settings) const
{
    settings.setLook(windowKey, saveGeometry());
    settings.setLook(columnsKey, _columns->saveState());
    settings.setLook(rowsKey, _rows->saveState());
    settings.setLook(logKey, _showsLog->isChecked() ? QByteArray() : hiddenLook);
}

void MainWindow::setRunning(bool running)
{
    _stop->setEnabled(running);
    if (!running)
        _runAgain->setEnabled(true);
}

void MainWindow::showCompositions(std::vector<CompositionEntry> const& entries)
{
    auto const current =
        std::find_if(entries.begin(), entries.end(), [](CompositionEntry const& entry) { return entry.isCurrent; });
    bool const isOpen = current != entries.end();
    // The mark of changes, which a name can hold as well.
    QString const mark = QStringLiteral("[*]");
    QString const name = isOpen ? QString(current->name).replace(mark, mark + mark) : QString();
    setWindowTitle(isOpen ? name + mark + QStringLiteral(" – Velmora") : QStringLiteral("Velmora"));
    setWindowModified(isOpen && current->isModified);
    _compositions->showCompositions(entries);
    _onComposition->setEnabled(isOpen);
    showInMenu(entries);
}

void MainWindow::showGraph(Kv::RCShdPtr<const Kv::PiGraph> const& graph)
{
    _nodeView->show(graph);
    _compositions->showNodes(graph);
}

void MainWindow::tell(QString const& text)
{
    _message->setText(text);
    _message->setToolTip(Qt::convertFromPlainText(text, Qt::WhiteSpaceNormal));
}

void MainWindow::showText(QString const& title, QString const& text)
{
    QDialog dialog(this);
    dialog.setWindowTitle(title);
    auto* const view = new QPlainTextEdit(text);
    view->setReadOnly(true);
    view->setLineWrapMode(QPlainTextEdit::NoWrap);
    view->setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));
    auto* const buttons = new QDialogButtonBox(QDialogButtonBox::Close);
    connect(buttons, &QDialogButtonBox::rejected, &dialog, &QDialog::reject);
    auto* const column = new QVBoxLayout(&dialog);
    column->addWidget(view);
    column->addWidget(buttons);
    constexpr QSize size(860, 320);
    dialog.resize(size.boundedTo(this->size()));
    dialog.exec();
    activateWindow();
}

void MainWindow::paintNow()
{
    // A window that has just been opened comes onto the screen a little later.
    constexpr int patience = 500;
    QElapsedTimer waited;
    waited.start();
    do
        QApplication::processEvents(QEventLoop::ExcludeUserInputEvents);
    while (isVisible() && !windowHandle()->isExposed() && !waited.hasExpired(patience));
}

void MainWindow::closeEvent(QCloseEvent* event)
{
    event->setAccepted(_commands.quit());
}

void MainWindow::makePanes(ScriptOutput& output)
{
    _browserPlace = new QWidget;
    _browserPlace->setObjectName(QStringLiteral("browserPlace"));
    _panel = new QWidget;
    _panel->setObjectName(QStringLiteral("mainPanel"));
    _nodeView = new NodeView(_panel);
    auto* const fill = new QVBoxLayout(_panel);
    fill->setContentsMargins(0, 0, 0, 0);
    fill->addWidget(_nodeView);
    _compositions = new CompositionPane(nullptr, _commands.makeCurrent);
    _columns = new QSplitter;
    _columns->setChildrenCollapsible(false);
    for (QWidget* const pane : {_browserPlace, _panel, static_cast<QWidget*>(_compositions)})
        _columns->addWidget(pane);
    constexpr int leastWidth = 160;
    _browserPlace->setMinimumWidth(leastWidth);
    _compositions->setMinimumWidth(leastWidth);
    _panel->setMinimumSize(leastWidth, leastWidth);
    // In shares of the whole.
    _columns->setSizes({width() * 25 / 100, width() * 53 / 100, width() * 22 / 100});
    _columns->setStretchFactor(0, 0);
    _columns->setStretchFactor(1, 1);
    _columns->setStretchFactor(2, 0);
    _log = new LogPane(nullptr, output);
    _rows = new QSplitter(Qt::Vertical);
    _rows->setChildrenCollapsible(false);
    _rows->addWidget(_columns);
    _rows->addWidget(_log);
    _rows->setSizes({height() * (100 - logShare) / 100, height() * logShare / 100});
    _rows->setStretchFactor(0, 1);
    _rows->setStretchFactor(1, 0);
    setCentralWidget(_rows);
}

void MainWindow::makeMenus()
{
    _own = new QActionGroup(this);
    _own->setExclusive(false);
    QMenu& file = *menuBar()->addMenu(tr("&File"));
    _onComposition = new QActionGroup(this);
    _onComposition->setExclusive(false);
    addCommand(file, tr("&Open Composition…"), QKeySequence::Open, _commands.openComposition);
    _onComposition->addAction(addCommand(file, tr("&Save Composition"), QKeySequence::Save, _commands.saveComposition));
    _onComposition->addAction(
        addCommand(file, tr("&Close Composition"), QKeySequence(tr("Ctrl+W")), _commands.closeComposition));
    file.addSeparator();
    addCommand(file, tr("&Quit"), QKeySequence::Quit, [this] { close(); });
    makeScriptMenu();
    _compositionMenu = menuBar()->addMenu(tr("&Compositions"));
    QMenu& compositions = *_compositionMenu;
    _onComposition->addAction(
        addCommand(compositions, tr("&Next"), QKeySequence(tr("Ctrl+PgDown")), [this] { _commands.step(1); }));
    _onComposition->addAction(
        addCommand(compositions, tr("&Previous"), QKeySequence(tr("Ctrl+PgUp")), [this] { _commands.step(-1); }));
    compositions.addSeparator();
    _onComposition->setEnabled(false);
    makeViewMenu();

    QMenu& help = *menuBar()->addMenu(tr("&Help"));
    addCommand(help, tr("&Build Information"), {}, _commands.showBuildInfo);
    for (QMenu const* const menu : {&file, &compositions, &help})
        _own->addAction(menu->menuAction());
}

void MainWindow::makeScriptMenu()
{
    QMenu& scripts = *menuBar()->addMenu(tr("&Script"));
    _own->addAction(addCommand(scripts, tr("&Run Script…"), QKeySequence(tr("Ctrl+R")), _commands.runScript));
    _runAgain =
        addCommand(scripts, tr("Run Script &Again"), QKeySequence(tr("Ctrl+Shift+R")), _commands.runScriptAgain);
    _runAgain->setEnabled(false);
    _own->addAction(_runAgain);
    QMenu& recent = *scripts.addMenu(tr("R&ecent Scripts"));
    connect(&recent, &QMenu::aboutToShow, this, [this, &recent] { showRecentScripts(recent); });
    _own->addAction(recent.menuAction());
    scripts.addSeparator();
    _stop = addCommand(scripts, tr("&Stop Script"), QKeySequence(tr("Ctrl+.")), _commands.stopScript);
    _stop->setEnabled(false);
}

void MainWindow::makeViewMenu()
{
    QMenu& view = *menuBar()->addMenu(tr("&View"));
    addCommand(view, tr("&Browser"), QKeySequence(tr("Alt+B")), _commands.goToBrowser);
    addCommand(view, tr("Uppermost &Dialog"), QKeySequence(tr("Alt+D")), [this] { goToDialog(); });
    addCommand(view, tr("Com&positions"), QKeySequence(tr("Alt+P")), [this] { _compositions->goToList(); });
    addCommand(view, tr("&Nodes"), QKeySequence(tr("Alt+N")), [this] { _compositions->goToNodes(); });
    addCommand(view, tr("&Log"), QKeySequence(tr("Alt+L")),
               [this]
               {
                   _showsLog->setChecked(true);
                   _log->goToText();
               });
    view.addSeparator();
    addCommand(view, tr("&Find in Log"), QKeySequence::Find,
               [this]
               {
                   _showsLog->setChecked(true);
                   _log->goToSearch();
               });
    _showsLog = view.addAction(tr("&Show Log"));
    _showsLog->setCheckable(true);
    _showsLog->setChecked(true);
    connect(_showsLog, &QAction::toggled, _log, &QWidget::setVisible);
    _own->addAction(view.menuAction());
}

void MainWindow::goToDialog()
{
    QObjectList const& floating = _panel->children();
    for (auto child = floating.rbegin(); child != floating.rend(); ++child)
        if (auto* const dialog = qobject_cast<QWidget*>(*child); dialog && dialog != _nodeView && dialog->isVisible())
        {
            QWidget* const holder = dialog->focusWidget();
            (holder ? holder : dialog)->setFocus(Qt::ShortcutFocusReason);
            return;
        }
    tell(tr("There is no dialog"));
}

void MainWindow::showRecentScripts(QMenu& menu)
{
    menu.clear();
    std::vector<std::string> const scripts = _commands.getRecentScripts();
    if (scripts.empty())
        menu.addAction(tr("None"))->setEnabled(false);
    int place = 0;
    for (std::string const& path : scripts)
    {
        QFileInfo const file(QString::fromStdString(path));
        QString const folder =
            fontMetrics().elidedText(QDir::toNativeSeparators(file.path()), Qt::ElideMiddle, menuWidth);
        QString const text = withoutShortcuts(file.fileName() + QStringLiteral("    ") + folder);
        addCommand(menu, QStringLiteral("&%1  %2").arg(++place % 10).arg(text), {},
                   [this, path] { _commands.runRecentScript(path); });
    }
    menu.addSeparator();
    addCommand(menu, tr("&Clear"), {}, _commands.forgetRecentScripts)->setEnabled(!scripts.empty());
}

void MainWindow::showInMenu(std::vector<CompositionEntry> const& entries)
{
    // Later: this may run on behalf of one of them.
    if (_openOnes)
    {
        for (QAction* const action : _openOnes->actions())
            _compositionMenu->removeAction(action);
        _openOnes->deleteLater();
    }
    _openOnes = new QActionGroup(this);
    int place = 0;
    for (CompositionEntry const& entry : entries)
    {
        auto* const action = new QAction(withoutShortcuts(entry.name), _openOnes);
        action->setCheckable(true);
        action->setChecked(entry.isCurrent);
        constexpr int lastDigit = 9;
        if (place < lastDigit)
            action->setShortcut(QKeySequence(QStringLiteral("Alt+%1").arg(place + 1)));
        connect(action, &QAction::triggered, this, [this, place] { _commands.makeCurrent(place); });
        _compositionMenu->addAction(action);
        ++place;
    }
}

} // namespace Velmora
