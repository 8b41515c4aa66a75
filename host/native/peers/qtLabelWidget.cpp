#include "peers/qtLabelWidget.h"

#include "windows/qtContentArea.h"

#include <QClipboard>
#include <QContextMenuEvent>
#include <QGuiApplication>
#include <QMenu>
#include <QPainter>
#include <QStyle>

#include <algorithm>

namespace Kv
{

QtLabelWidget::QtLabelWidget(QWidget* parent) : QLabel(parent)
{
    setTextFormat(Qt::PlainText);
    // The layout gives the text exactly its measured width.
    setMargin(0);
    setIndent(0);
}

void QtLabelWidget::setWords(QString const& words)
{
    _words = words;
    showWords();
    if (_isTitle)
        parentWidget()->setAccessibleName(words);
    else
        nameSoon();
}

void QtLabelWidget::makeTitle()
{
    _isTitle = true;
    constexpr int indent = 8;
    setIndent(indent);
    QFont bold = font();
    bold.setBold(true);
    setFont(bold);
    parentWidget()->setAccessibleName(_words);
}

void QtLabelWidget::setNamed(QWidget* widget)
{
    if (widget == buddy())
        return;
    clear();
    setBuddy(widget);
    showWords();
}

bool QtLabelWidget::event(QEvent* event)
{
    if (event->type() == QEvent::ShowToParent || event->type() == QEvent::HideToParent)
        nameSoon();
    if (event->type() == QEvent::ToolTip && getLines().isCut)
        return showWhole(*this, *event, _words);
    return QLabel::event(event);
}

void QtLabelWidget::enterEvent(QEnterEvent* event)
{
    QLabel::enterEvent(event);
    if (_isTitle || _words.isEmpty())
        return;
    // Only now: what makes a text selectable is costly, and few texts are ever selected in.
    setTextInteractionFlags(Qt::TextSelectableByMouse);
    setFocusPolicy(Qt::NoFocus);
    setCursor(Qt::IBeamCursor);
    // A selected text is drawn by Qt, from the top of its room: where the lines stand that are seen.
    setContentsMargins({});
    int const lines = static_cast<int>(getLines().lines.size());
    int const above = std::max(0, (height() - lines * fontMetrics().lineSpacing()) / 2);
    setContentsMargins(0, above, 0, above);
    setWordWrap(lines > 1);
}

void QtLabelWidget::mouseReleaseEvent(QMouseEvent* event)
{
    QLabel::mouseReleaseEvent(event);
    // So that the key for it copies. A mere click leaves the keyboard where it is.
    if (hasSelectedText())
        setFocus(Qt::MouseFocusReason);
}

void QtLabelWidget::contextMenuEvent(QContextMenuEvent* event)
{
    if (_words.isEmpty())
        return;
    auto* const menu = new QMenu(this);
    menu->setAttribute(Qt::WA_DeleteOnClose);
    menu->addAction(QStringLiteral("Copy"), this,
                    [this] { QGuiApplication::clipboard()->setText(hasSelectedText() ? selectedText() : _words); });
    menu->popup(event->globalPos());
}

void QtLabelWidget::paintEvent(QPaintEvent* event)
{
    if (hasSelectedText())
    {
        QLabel::paintEvent(event);
        return;
    }
    QPainter painter(this);
    style()->drawItemText(&painter, getRoom(), static_cast<int>(alignment()) | Qt::TextExpandTabs, palette(),
                          isEnabled(), getLines().lines.join(QLatin1Char('\n')), foregroundRole());
}

void QtLabelWidget::showWords()
{
    // For a label that names a widget, a lone ampersand marks a shortcut.
    setText(buddy() ? QString(_words).replace(QLatin1Char('&'), QLatin1String("&&")) : _words);
}

QRect QtLabelWidget::getRoom() const
{
    return contentsRect().adjusted(indent(), 0, 0, 0);
}

TextLines QtLabelWidget::getLines() const
{
    return breakIntoLines(_words, font(), getRoom().size());
}

void QtLabelWidget::nameSoon() const
{
    for (QWidget* around = parentWidget(); around; around = around->parentWidget())
        if (auto* const area = dynamic_cast<QtContentArea*>(around))
        {
            area->nameValuesSoon();
            return;
        }
}

} // namespace Kv
