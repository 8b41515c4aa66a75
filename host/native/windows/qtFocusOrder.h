#pragma once

#include <QPointer>
#include <QWidget>

#include <cstddef>
#include <vector>

namespace Kv
{

/// Base of the widgets that hold a value: such a one has the keyboard first.
class QtValueWidget
{
public:
    QtValueWidget() = default;
    QtValueWidget(QtValueWidget const&) = delete;
    QtValueWidget& operator=(QtValueWidget const&) = delete;
    virtual ~QtValueWidget() = default;
};

/// The way of the keyboard through the widgets: as the eye goes, row by row from the top, each from left to right.
class QtFocusOrder
{
public:
    using Row = std::vector<QWidget*>;

    /// Sorts widgets of one window as they are laid out now. A row is what stands beside its uppermost widget.
    static std::vector<Row> sortIntoRows(std::vector<QWidget*> const& widgets);

    /// The order in a widget as it is laid out now.
    explicit QtFocusOrder(QWidget const& root);

    /// Gives the keyboard to the next widget or the one before, around the ends. The one that has it need not take the
    /// keyboard any more. False where nothing else does. What takes it only since the order was found is left out.
    bool step(bool next);

    /// True where the widget that has the keyboard is in the order: a step goes from there.
    bool leadsOn();

    /// True for a `QtValueWidget`, and for a widget that hands the keyboard on to one.
    static bool holdsValue(QWidget const& widget);

    /// The first widget that holds a value, else the first push button, else null.
    QWidget* getFirst() const;

    /// True for a widget that takes input whenever its window is on the screen.
    static bool canHold(QWidget const& widget);

    /// Gives a widget the keyboard as Tab would, and scrolls it into view.
    static void give(QWidget& widget, Qt::FocusReason reason);

private:
    QWidget* find(int direction);

    QWidget const* _root;
    /// Some can go while others walk through them.
    std::vector<QPointer<QWidget>> _stops;
    /// Where the widget was that had the keyboard when it was looked for last.
    std::size_t _place = 0;
};

} // namespace Kv
