#include "mainWindow.h"

#include "nodeView.h"

#include <QApplication>
#include <QCloseEvent>
#include <QDialog>
#include <QDialogButtonBox>
#include <QElapsedTimer>
#include <QFontDatabase>
#include <QMenuBar>
#include <QPlainTextEdit>
#include <QScreen>
#include <QSplitter>
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

constexpr QSize windowSize(1180, 720);

/// What a window manager adds, which is known only when it is too late.
constexpr QSize windowFrame(8, 40);

QAction* addCommand(QMenu& menu, QString const& text, QKeySequence const& keys, std::function<void()> const& run)
{
    QAction* const action = menu.addAction(text, keys, &menu, run);
    action->setMenuRole(QAction::NoRole);
    return action;
}

} // namespace

MainWindow::MainWindow(Commands commands) : _commands(std::move(commands))
{
    setObjectName(QStringLiteral("Velmora"));
    setWindowTitle(QStringLiteral("Velmora"));
    resize(windowSize.boundedTo(screen()->availableGeometry().size() - windowFrame));
    makePanes();
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
    menuBar()->setEnabled(enabled);
    _browserPlace->setEnabled(enabled);
    _nodeView->setEnabled(enabled);
    _compositions->setEnabled(enabled);
    statusBar()->setEnabled(enabled);
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

void MainWindow::makePanes()
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
    auto* const panes = new QSplitter;
    panes->setChildrenCollapsible(false);
    for (QWidget* const pane : {_browserPlace, _panel, static_cast<QWidget*>(_compositions)})
        panes->addWidget(pane);
    constexpr int leastWidth = 160;
    _browserPlace->setMinimumWidth(leastWidth);
    _compositions->setMinimumWidth(leastWidth);
    _panel->setMinimumSize(leastWidth, leastWidth);
    // In shares of the whole.
    panes->setSizes({width() * 25 / 100, width() * 53 / 100, width() * 22 / 100});
    panes->setStretchFactor(0, 0);
    panes->setStretchFactor(1, 1);
    panes->setStretchFactor(2, 0);
    setCentralWidget(panes);
}

void MainWindow::makeMenus()
{
    QMenu& file = *menuBar()->addMenu(tr("&File"));
    _onComposition = new QActionGroup(this);
    _onComposition->setExclusive(false);
    addCommand(file, tr("&Open Composition…"), QKeySequence::Open, _commands.openComposition);
    _onComposition->addAction(addCommand(file, tr("&Save Composition"), QKeySequence::Save, _commands.saveComposition));
    _onComposition->addAction(
        addCommand(file, tr("&Close Composition"), QKeySequence(tr("Ctrl+W")), _commands.closeComposition));
    file.addSeparator();
    addCommand(file, tr("&Run Script…"), QKeySequence(tr("Ctrl+R")), _commands.runScript);
    _runAgain = addCommand(file, tr("Run Script &Again"), QKeySequence(tr("Ctrl+Shift+R")), _commands.runScriptAgain);
    _runAgain->setEnabled(false);
    file.addSeparator();
    addCommand(file, tr("&Quit"), QKeySequence::Quit, [this] { close(); });

    _compositionMenu = menuBar()->addMenu(tr("&Compositions"));
    QMenu& compositions = *_compositionMenu;
    _onComposition->addAction(
        addCommand(compositions, tr("&Next"), QKeySequence(tr("Ctrl+PgDown")), [this] { _commands.step(1); }));
    _onComposition->addAction(
        addCommand(compositions, tr("&Previous"), QKeySequence(tr("Ctrl+PgUp")), [this] { _commands.step(-1); }));
    compositions.addSeparator();
    _onComposition->setEnabled(false);

    QMenu& help = *menuBar()->addMenu(tr("&Help"));
    addCommand(help, tr("&Build Information"), {}, _commands.showBuildInfo);
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
        auto* const action = new QAction(QString(entry.name).replace(QLatin1Char('&'), QLatin1String("&&")), _openOnes);
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
