#pragma once

#include <QWidget>

#include <string>

class QAbstractItemView;
class QComboBox;

namespace Kv
{

/// The keys and the mouse of a user.
class QtHand
{
public:
    /// The reason why a click does not reach the widget, after a verb; empty where it does. Scrolls it into view.
    static QString findObstacle(QWidget& widget);

    static void click(QWidget& widget);

    /// Clicks on a row.
    static void pick(QAbstractItemView& list, int row, bool isMore);

    /// Opens the menu and picks an entry.
    static void pick(QComboBox& menu, int entry);

    /// Types into what has the keyboard of the dialog, as long as that is there.
    static void type(QWidget& dialog, QString const& text);

    /// False for what is no name of a key.
    static bool press(QWidget& dialog, QString const& key);
};

} // namespace Kv
