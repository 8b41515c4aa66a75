#pragma once

#include "windows/qtFocusOrder.h"

#include <QTreeView>

#include <functional>

namespace Kv
{

/// The list of a browser with its keys and clicks; shows the columns that there is room for. A key that is not its own,
/// as Escape, goes on to what holds it.
class QtBrowserList final : public QTreeView, public QtValueWidget
{
public:
    /// Functions that keys and clicks call; all are set before the list is shown.
    struct Actions
    {
        /// Enter, or a double click, on the current row.
        std::function<void()> activate;
        std::function<void()> goUp;
    };

    QtBrowserList(QWidget* parent, Actions actions);

    /// Words that stand in the list while it has no rows.
    void setPlaceholder(QString const& text);

protected:
    void keyPressEvent(QKeyEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseDoubleClickEvent(QMouseEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void changeEvent(QEvent* event) override;

private:
    /// Selects the row that the keyboard is on, where nothing is selected: what a key does next is seen before. True if
    /// it has.
    bool selectFirst();
    void fitColumns();

    Actions _actions;
    QString _placeholder;
};

} // namespace Kv
