#include "peers/qtLongText.h"

#include "peers/qtText.h"

#include <QFontMetrics>
#include <QGuiApplication>
#include <QHelpEvent>
#include <QScreen>
#include <QTextLayout>
#include <QToolTip>

#include <algorithm>

namespace Kv
{

namespace
{

constexpr QChar ellipsis(0x2026);

bool fits(QFontMetrics const& metrics, QString const& line, int width)
{
    return metrics.size(Qt::TextExpandTabs, line).width() <= width;
}

/// Ends a line by an ellipsis.
QString cut(QFontMetrics const& metrics, QString line, int width)
{
    // An ellipsis is put by the width without the tabs.
    line.replace(QLatin1Char('\t'), QLatin1String("    "));
    return metrics.elidedText(line.append(ellipsis), Qt::ElideRight, width);
}

/// The places where the lines of a paragraph begin, `most` at most.
std::vector<int> findBreaks(QString const& paragraph, QFont const& font, int width, int most)
{
    if (most == 1 || fits(QFontMetrics(font), paragraph, width))
        return {0};
    QTextLayout layout(paragraph, font);
    QTextOption option;
    option.setWrapMode(QTextOption::WrapAtWordBoundaryOrAnywhere);
    layout.setTextOption(option);
    std::vector<int> breaks;
    layout.beginLayout();
    while (static_cast<int>(breaks.size()) < most)
    {
        QTextLine line = layout.createLine();
        if (!line.isValid())
            break;
        line.setLineWidth(width);
        breaks.push_back(line.textStart());
    }
    layout.endLayout();
    return breaks;
}

} // namespace

TextLines breakIntoLines(QString const& whole, QFont const& font, int width, int most)
{
    QFontMetrics const metrics(font);
    QString const text = toShown(whole);
    // More characters than pixels are never seen.
    qsizetype const limit = static_cast<qsizetype>(most) * std::max(width, 1);
    qsizetype size = text.size();
    while (size > 0 && text[size - 1] == QLatin1Char('\n'))
        --size;
    TextLines result;
    QStringList& lines = result.lines;
    for (qsizetype start = 0; start <= size;)
    {
        qsizetype const next = text.indexOf(QLatin1Char('\n'), start);
        qsizetype const end = next < 0 ? size : std::min(next, size);
        bool const isLonger = end - start > limit;
        QString const paragraph = text.mid(start, std::min(end - start, limit));
        std::vector<int> const breaks = findBreaks(paragraph, font, width, most - static_cast<int>(lines.size()));
        for (std::size_t line = 0; line + 1 < breaks.size(); ++line)
            lines << paragraph.mid(breaks[line], breaks[line + 1] - breaks[line]);
        QString const last = paragraph.mid(breaks.back());
        start = end + 1;
        bool const isFull = lines.size() + 1 == most;
        result.isCut = isLonger || (isFull && (start <= size || !fits(metrics, last, width)));
        lines << (result.isCut ? cut(metrics, last, width) : last);
        if (isFull || isLonger)
            break;
    }
    result.isCut = result.isCut || text.size() < whole.size();
    return result;
}

TextLines breakIntoLines(QString const& text, QFont const& font, QSize const& room)
{
    return breakIntoLines(text, font, room.width(), std::max(1, room.height() / QFontMetrics(font).lineSpacing()));
}

QString toTooltip(QString const& text)
{
    QScreen const* const screen = QGuiApplication::primaryScreen();
    if (text.isEmpty() || !screen || screen->availableSize().isEmpty())
        return text;
    QFont const font = QToolTip::font();
    // It fits above the pointer or below it: one that lies under the pointer goes at once.
    QSize const screenSize = screen->availableSize();
    QSize const room(screenSize.width() * 19 / 20, screenSize.height() * 9 / 20);
    constexpr int columns = 80;
    int const pleasant = std::min(columns * QFontMetrics(font).averageCharWidth(), room.width());
    TextLines shown = breakIntoLines(text, font, {pleasant, room.height()});
    if (shown.isCut)
        shown = breakIntoLines(text, font, room);
    QString const tip = shown.lines.join(QLatin1Char('\n'));
    return Qt::mightBeRichText(tip) ? Qt::convertFromPlainText(tip, Qt::WhiteSpacePre) : tip;
}

bool showWhole(QWidget& widget, QEvent const& event, QString const& text)
{
    if (event.type() != QEvent::ToolTip || text.isEmpty())
        return false;
    QString const own = widget.accessibleDescription();
    QString const whole = own.isEmpty() ? text : text + QLatin1String("\n\n") + own;
    QToolTip::showText(static_cast<QHelpEvent const&>(event).globalPos(), toTooltip(whole), &widget);
    return true;
}

} // namespace Kv
