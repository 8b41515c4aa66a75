#include "logPane.h"

#include "theme.h"

#include "wsNative.h"

#include <QApplication>
#include <QClipboard>
#include <QDateTime>
#include <QFontDatabase>
#include <QHBoxLayout>
#include <QPainter>
#include <QPlainTextEdit>
#include <QRegularExpression>
#include <QScrollBar>
#include <QTextBlock>
#include <QThread>
#include <QToolButton>
#include <QVBoxLayout>

#include <algorithm>

namespace Velmora
{

namespace
{

/// The share of a script's time that its output may take to be seen at once, and how much of it can be saved up, in
/// nanoseconds.
constexpr qint64 shareOfTime = 5;
constexpr qint64 maxCredit = 60'000'000;

/// The greatest number of finds of a search that are marked.
constexpr int maxMarks = 1000;

constexpr int timeAir = 8;

/// The data of a line beside its text.
class LineData final : public QTextBlockUserData
{
public:
    explicit LineData(LogLine const& line)
        : time(QDateTime::fromSecsSinceEpoch(std::chrono::system_clock::to_time_t(line.time))
                   .toString(QStringLiteral("HH:mm:ss"))),
          isError(line.kind == LogLine::Kind::Error)
    {
    }

    QString time;
    bool isError;
};

/// A line as it is shown: without the sequences that colour a terminal, and all of it in one line.
QString makeText(std::string const& bytes)
{
    static QRegularExpression const sequences(QStringLiteral("\x1b\\[[0-?]*[ -/]*[@-~]"));
    static QRegularExpression const breaks(QStringLiteral("[\\x{2028}\\x{2029}\\x{fdd0}\\x{fdd1}]"));
    return QString::fromUtf8(bytes.data(), static_cast<qsizetype>(bytes.size()))
        .remove(sequences)
        .replace(breaks, QStringLiteral(" "));
}

/// True while some widget of the window paints itself: another one cannot be painted then.
bool isPainting(QWidget const& window)
{
    QList<QWidget*> const widgets = window.findChildren<QWidget*>();
    return std::any_of(widgets.begin(), widgets.end(),
                       [](QWidget const* widget) { return widget->testAttribute(Qt::WA_WState_InPaintEvent); });
}

} // namespace

/// The text of the log, with the times in a margin of their own: they are no part of what is found and copied.
class LogView final : public QPlainTextEdit
{
public:
    LogView() : _margin(new Margin(*this))
    {
        setPlaceholderText(tr("What scripts print stands here"));
        setObjectName(QStringLiteral("log"));
        setAccessibleName(tr("Log"));
        setReadOnly(true);
        setUndoRedoEnabled(false);
        setLineWrapMode(NoWrap);
        setMaximumBlockCount(logLength);
        setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));
        setUsable(true);
        setViewportMargins(getMarginWidth(), 0, 0, 0);
        connect(this, &QPlainTextEdit::updateRequest, _margin, [this] { _margin->update(); });
        QScrollBar* const bar = verticalScrollBar();
        connect(bar, &QScrollBar::valueChanged, this, [this, bar] { _follows = bar->value() == bar->maximum(); });
        connect(bar, &QScrollBar::rangeChanged, this,
                [this, bar] { bar->setValue(_follows ? bar->maximum() : bar->value()); });
    }

    void setUsable(bool usable)
    {
        setFocusPolicy(usable ? Qt::StrongFocus : Qt::NoFocus);
        setTextInteractionFlags(usable ? Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard
                                       : Qt::NoTextInteraction);
    }

    void append(std::deque<LogLine> const& lines)
    {
        bool const follows = _follows;
        int const top = verticalScrollBar()->value();
        int count = blockCount();
        QTextCursor cursor(document());
        cursor.movePosition(QTextCursor::End);
        cursor.beginEditBlock();
        for (LogLine const& line : lines)
        {
            if (!_continues && cursor.block().userData())
            {
                cursor.insertBlock();
                ++count;
            }
            writeLast(cursor, line);
            _continues = line.isOpen;
        }
        cursor.endEditBlock();
        if (!follows)
            verticalScrollBar()->setValue(std::max(0, top - (count - blockCount())));
    }

    void removeAll()
    {
        QTextCursor cursor(document());
        cursor.select(QTextCursor::Document);
        cursor.removeSelectedText();
        cursor.block().setUserData(nullptr);
        _continues = false;
    }

    /// Marks the places where the text stands, the selected one more than the others, and gives their number.
    int mark(QString const& wanted)
    {
        QTextCharFormat other;
        other.setBackground(palette().brush(QPalette::Inactive, QPalette::Highlight));
        QTextCharFormat selected;
        selected.setBackground(palette().brush(QPalette::Active, QPalette::Highlight));
        selected.setForeground(palette().brush(QPalette::Active, QPalette::HighlightedText));
        QList<QTextEdit::ExtraSelection> places;
        if (!wanted.isEmpty())
            for (QTextCursor place = document()->find(wanted); !place.isNull() && places.size() < maxMarks;
                 place = document()->find(wanted, place))
                places.append({place, place == textCursor() ? selected : other});
        setExtraSelections(places);
        return static_cast<int>(places.size());
    }

    /// Selects the next place where the text stands, around the ends.
    void goToNext(QString const& wanted, QTextDocument::FindFlags direction)
    {
        QTextCursor place = document()->find(wanted, textCursor(), direction);
        if (place.isNull())
        {
            place = QTextCursor(document());
            place.movePosition(direction & QTextDocument::FindBackward ? QTextCursor::End : QTextCursor::Start);
            place = document()->find(wanted, place, direction);
        }
        if (!place.isNull())
            setTextCursor(place);
    }

    /// Leaves the cursor where the selection began.
    void dropSelection()
    {
        QTextCursor cursor = textCursor();
        cursor.setPosition(cursor.selectionStart());
        setTextCursor(cursor);
    }

protected:
    void resizeEvent(QResizeEvent* event) override
    {
        QPlainTextEdit::resizeEvent(event);
        _margin->setGeometry(viewport()->x() - getMarginWidth(), viewport()->y(), getMarginWidth(),
                             viewport()->height());
    }

private:
    class Margin final : public QWidget
    {
    public:
        explicit Margin(LogView& view) : QWidget(&view), _view(view) {}

    protected:
        void paintEvent(QPaintEvent*) override { _view.paintTimes(); }
        void wheelEvent(QWheelEvent* event) override { QCoreApplication::sendEvent(_view.viewport(), event); }

    private:
        LogView& _view;
    };

    int getMarginWidth() const { return fontMetrics().horizontalAdvance(QStringLiteral("00:00:00")) + 2 * timeAir; }

    static void writeLast(QTextCursor& cursor, LogLine const& line)
    {
        cursor.movePosition(QTextCursor::StartOfBlock, QTextCursor::KeepAnchor);
        cursor.removeSelectedText();
        QTextCharFormat format;
        if (line.kind == LogLine::Kind::Error)
            format.setForeground(getErrorColor());
        else if (line.kind == LogLine::Kind::Note)
            format.setForeground(QGuiApplication::palette().link());
        cursor.insertText(makeText(line.text), format);
        cursor.block().setUserData(new LineData(line));
    }

    void paintTimes() const
    {
        QPainter painter(_margin);
        painter.fillRect(_margin->rect(), palette().base());
        painter.setFont(font());
        for (QTextBlock block = firstVisibleBlock(); block.isValid(); block = block.next())
        {
            QRectF const place = blockBoundingGeometry(block).translated(contentOffset());
            if (place.top() > _margin->height())
                return;
            auto const* const line = static_cast<LineData const*>(block.userData());
            if (!line)
                continue;
            QTextLine const text = block.layout()->lineAt(0);
            painter.setPen(palette().color(QPalette::Active, QPalette::PlaceholderText));
            painter.drawText(QPointF(timeAir, place.top() + text.ascent()), line->time);
            // Not by the colour of the text alone.
            if (line->isError)
                painter.fillRect(QRectF(_margin->width() - 4, place.top(), 2, text.height()), getErrorColor());
        }
    }

    Margin* _margin;
    bool _follows = true;
    /// The last line was open when it was written.
    bool _continues = false;
};

LogPane::LogPane(QWidget* parent, ScriptOutput& output)
    : QWidget(parent), _output(output), _view(new LogView), _wanted(new QLineEdit), _found(new QLabel)
{
    layOut();
    _sinceCredit.start();
    connect(_wanted, &QLineEdit::textChanged, this,
            [this]
            {
                _view->dropSelection();
                search({});
            });
    connect(_wanted, &QLineEdit::returnPressed, this,
            [this]
            {
                bool const isShifted = QGuiApplication::keyboardModifiers() & Qt::ShiftModifier;
                search(isShifted ? QTextDocument::FindBackward : QTextDocument::FindFlags());
            });
    _output.setListener([this] { onPrinted(); });
}

LogPane::~LogPane()
{
    _output.setListener(nullptr);
}

void LogPane::note(QString const& text)
{
    _output.add(LogLine::Kind::Note, text.toStdString() + '\n');
}

void LogPane::goToText()
{
    _view->setFocus(Qt::ShortcutFocusReason);
}

void LogPane::goToSearch()
{
    _wanted->setFocus(Qt::ShortcutFocusReason);
    _wanted->selectAll();
}

void LogPane::setUsable(bool usable)
{
    _view->setUsable(usable);
    for (QWidget* const tool : _tools)
        tool->setEnabled(usable);
}

void LogPane::layOut()
{
    auto* const title = new QLabel(tr("Log"));
    QFont bold = title->font();
    bold.setBold(true);
    title->setFont(bold);
    _wanted->setObjectName(QStringLiteral("logSearch"));
    _wanted->setAccessibleName(tr("Find in the log"));
    _wanted->setPlaceholderText(tr("Find"));
    _wanted->setClearButtonEnabled(true);
    constexpr int searchWidth = 220;
    _wanted->setMaximumWidth(searchWidth);
    constexpr int gap = 6;
    auto* const row = new QHBoxLayout;
    row->setSpacing(gap);
    row->addWidget(title);
    row->addStretch();
    row->addWidget(_found);
    row->addWidget(_wanted, 1);
    row->addWidget(makeButton(tr("Copy"), tr("Copies what is selected, or all of it"), &LogPane::copy));
    row->addWidget(makeButton(tr("Clear"), tr("Empties the log"), &LogPane::clear));
    _tools.push_back(_wanted);
    auto* const column = new QVBoxLayout(this);
    column->setContentsMargins(gap, gap, gap, 0);
    column->setSpacing(gap);
    column->addLayout(row);
    column->addWidget(_view);
}

QAbstractButton* LogPane::makeButton(QString const& text, QString const& tip, void (LogPane::*run)())
{
    auto* const button = new QToolButton;
    button->setText(text);
    button->setToolTip(tip);
    button->setAutoRaise(true);
    connect(button, &QToolButton::clicked, this, run);
    _tools.push_back(button);
    return button;
}

void LogPane::onPrinted()
{
    if (QThread::currentThread() == thread() && isVisible() && !isPainting(*window()) && hasCredit() &&
        Kv::WsNative::getPlatform().hasDisplay())
    {
        showNew();
        repaint();
        _credit -= _sinceCredit.nsecsElapsed();
        return;
    }
    QMetaObject::invokeMethod(
        this, [this] { showNew(); }, Qt::QueuedConnection);
}

bool LogPane::hasCredit()
{
    _credit = std::min(maxCredit, _credit + _sinceCredit.nsecsElapsed() / shareOfTime);
    _sinceCredit.start();
    return _credit > 0;
}

void LogPane::showNew()
{
    _view->append(_output.take());
}

void LogPane::copy()
{
    QTextCursor const cursor = _view->textCursor();
    if (cursor.hasSelection())
        _view->copy();
    else
        QGuiApplication::clipboard()->setText(_view->toPlainText());
}

void LogPane::clear()
{
    _view->removeAll();
    _found->clear();
}

void LogPane::search(QTextDocument::FindFlags direction)
{
    QString const wanted = _wanted->text();
    _view->goToNext(wanted, direction);
    int const count = _view->mark(wanted);
    QString found = count > 0 ? tr("%1 found").arg(count) : tr("nothing found");
    if (count == maxMarks)
        found = tr("%1 or more found").arg(count);
    _found->setText(wanted.isEmpty() ? QString() : found);
}

} // namespace Velmora
