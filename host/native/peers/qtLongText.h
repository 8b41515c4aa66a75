#pragma once

#include <QEvent>
#include <QFont>
#include <QStringList>
#include <QWidget>

namespace Kv
{

/// The lines of a text that there is room for; the last one ends in an ellipsis where the text is cut.
struct TextLines
{
    QStringList lines;
    bool isCut = false;
};

/// Breaks what is shown of a text into lines, at its line ends and where a line would be wider than `width`, in pixels.
/// It gives at most `most` of them, and one at least.
TextLines breakIntoLines(QString const& whole, QFont const& font, int width, int most);

/// Breaks a text into as many lines as fit into the room.
TextLines breakIntoLines(QString const& text, QFont const& font, QSize const& room);

/// A text as a tooltip shows it: nothing in it is markup, and no line of it is endless.
QString toTooltip(QString const& text);

/// Answers the question for a tooltip, where `event` is one, with a text that the widget cuts; the widget's own tooltip
/// stands below. False for another event, and for an empty text.
bool showWhole(QWidget& widget, QEvent const& event, QString const& text);

} // namespace Kv
