#pragma once

#include <QWidget>

#include <vector>

namespace Kv
{

/// How the keyboard goes through the widgets: as the eye does, row by row from the top, each from left to right.
class QtFocusOrder
{
public:
    /// The order in a widget as it is laid out now.
    explicit QtFocusOrder(QWidget const& root);

    /// The one after `current` or before it, around the ends. `current` need not take the keyboard any more. Null where
    /// nothing else does.
    QWidget* getNext(QWidget const* current) const;
    QWidget* getPrevious(QWidget const* current) const;

    /// Says that a widget holds a value: such a one has the keyboard first.
    static void markAsValue(QWidget& widget);

    /// The first widget that holds a value, else the first push button, else null.
    QWidget* getFirst() const;

    /// Gives a widget the keyboard as Tab would, and scrolls it into view.
    static void give(QWidget& widget, Qt::FocusReason reason);

private:
    QWidget* step(QWidget const* current, int direction) const;

    std::vector<QWidget*> _stops;
};

} // namespace Kv
