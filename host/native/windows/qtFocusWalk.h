#pragma once

#include "windows/qtFocusOrder.h"

#include <QObject>

#include <optional>

namespace Kv
{

/// Walks the keyboard through the widgets in one. Qt asks for a step also where the widget that has the keyboard is
/// hidden or disabled: the order is found once for a script that does so to all of them, one after the other.
class QtFocusWalk final : public QObject
{
public:
    /// `root` is borrowed, and owns the walk.
    explicit QtFocusWalk(QWidget& root) : _root(root) {}

    /// Gives the keyboard to the next widget or the one before. False where nothing else takes it.
    bool step(bool next);

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void findOrder();
    void forgetOrder();

    /// True for what can bring another widget into the order, or give one another place in it.
    bool changesOrder(QWidget const& widget, QEvent const& event) const;

    QWidget& _root;
    /// As it was found in the event that is handled, unless it has changed since.
    std::optional<QtFocusOrder> _order;
    bool _forgetting = false;
};

} // namespace Kv
