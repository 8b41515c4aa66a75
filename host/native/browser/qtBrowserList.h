#pragma once

#include <QTreeView>

#include <functional>

namespace Kv
{

/// The list of a browser: keys and clicks, and which columns there is room for. What is not its own, as Escape, goes on
/// to what holds it.
class QtBrowserList final : public QTreeView
{
public:
    /// What the list asks for; all are set before it is shown.
    struct Wishes
    {
        /// Enter, or a double click, on the current row.
        std::function<void()> activate;
        std::function<void()> goUp;
    };

    QtBrowserList(QWidget* parent, Wishes wishes);

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
    /// Where nothing is selected, selects the row that the keyboard is on: what a key does next is seen before. True if
    /// it has.
    bool selectFirst();
    void fitColumns();

    Wishes _wishes;
    QString _placeholder;
};

} // namespace Kv
