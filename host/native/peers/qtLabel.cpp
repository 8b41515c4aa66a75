#include "peers/qtLabel.h"

#include "ntLabel.h"
#include "peers/qtPeer.h"
#include "peers/qtText.h"
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

namespace
{

class Label final : public QtPeerOf<NtLabel, QtLabel>
{
public:
    Label(QWidget* parent, std::string const& name, NtNoListener& nobody) : QtPeerOf(parent, name, 0, nobody)
    {
        Label::setAlign(NtAlign::Left);
    }

    void setText(std::string const& text) override
    {
        if (QtLabel* const label = getNative())
            label->setWords(toQString(text));
    }

    void setAlign(NtAlign align) override
    {
        if (QtLabel* const label = getNative())
            label->setAlignment(toQtAlignment(align));
    }
};

QtPeerKind<NtLabel, Label> registered;

} // namespace

QtLabel::QtLabel(QWidget* parent) : QLabel(parent)
{
    setTextFormat(Qt::PlainText);
    // The layout gives the text exactly its measured width.
    setMargin(0);
    setIndent(0);
}

void QtLabel::setWords(QString const& words)
{
    _words = words;
    _shown = toShown(words);
    showWords();
    if (_isTitle)
        parentWidget()->setAccessibleName(_shown);
    else
        nameSoon();
}

void QtLabel::makeTitle()
{
    _isTitle = true;
    constexpr int indent = 8;
    setIndent(indent);
    QFont bold = font();
    bold.setBold(true);
    setFont(bold);
    parentWidget()->setAccessibleName(_shown);
}

void QtLabel::setNamed(QWidget* widget)
{
    if (widget == buddy())
        return;
    // With a buddy an ampersand marks a shortcut.
    bool const hasAmpersand = _shown.contains(QLatin1Char('&'));
    if (hasAmpersand)
        clear();
    setBuddy(widget);
    if (hasAmpersand)
        showWords();
}

bool QtLabel::event(QEvent* event)
{
    if (event->type() == QEvent::ShowToParent || event->type() == QEvent::HideToParent)
        nameSoon();
    if (event->type() == QEvent::ToolTip && getLines().isCut)
        return showWhole(*this, *event, _words);
    return QLabel::event(event);
}

void QtLabel::enterEvent(QEnterEvent* event)
{
    QLabel::enterEvent(event);
    // Of a longer text Qt takes seconds to find what lies under the mouse. It can be copied all the same.
    constexpr qsizetype mostSelectable = 10'000;
    if (_isTitle || _words.isEmpty() || _words.size() > mostSelectable)
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

void QtLabel::mouseReleaseEvent(QMouseEvent* event)
{
    QLabel::mouseReleaseEvent(event);
    // So that the key for it copies. A mere click leaves the keyboard where it is.
    if (hasSelectedText())
        setFocus(Qt::MouseFocusReason);
}

void QtLabel::contextMenuEvent(QContextMenuEvent* event)
{
    if (_words.isEmpty())
        return;
    auto* const menu = new QMenu(this);
    menu->setAttribute(Qt::WA_DeleteOnClose);
    menu->addAction(QStringLiteral("Copy"), this,
                    [this] { QGuiApplication::clipboard()->setText(hasSelectedText() ? selectedText() : _words); });
    menu->popup(event->globalPos());
}

void QtLabel::paintEvent(QPaintEvent* event)
{
    if (hasSelectedText())
    {
        QLabel::paintEvent(event);
        return;
    }
    QPainter painter(this);
    painter.setLayoutDirection(layoutDirection());
    style()->drawItemText(&painter, getRoom(), static_cast<int>(alignment()) | Qt::TextExpandTabs, palette(),
                          isEnabled(), getLines().lines.join(QLatin1Char('\n')), foregroundRole());
}

void QtLabel::showWords()
{
    setText(buddy() ? withoutShortcuts(_shown) : _shown);
}

QRect QtLabel::getRoom() const
{
    return contentsRect().adjusted(indent(), 0, 0, 0);
}

TextLines QtLabel::getLines() const
{
    return breakIntoLines(_words, font(), getRoom().size());
}

void QtLabel::nameSoon() const
{
    for (QWidget* around = parentWidget(); around; around = around->parentWidget())
        if (auto* const area = dynamic_cast<QtContentArea*>(qobject_cast<QScrollArea*>(around)))
        {
            area->nameValuesSoon();
            return;
        }
}

} // namespace Kv
