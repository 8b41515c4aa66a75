#pragma once

#include <QPointer>
#include <QWidget>

#include <vector>

namespace Kv
{

class QtFloat;

/// The floats of the process in the order in which they came to the front, and among them what else had the keyboard.
///
/// Qt stacks only what has one parent: a float in a pane lies beneath each float of the window. One that lies beneath
/// another though it came to the front later is seen through a hole in that.
class QtFrontOrder
{
public:
    static QtFrontOrder& getInstance();

    void bringToFront(QtFloat& floating);
    void remove(QtFloat& floating);

    /// A widget of the window's own, in no float, has got the keyboard: it stands before all floats for now.
    void rememberKeyboard(QWidget& widget);

    /// The float that came to the front last; null if there is none.
    QtFloat* getFront() const;

    /// A float has been moved, shown or hidden.
    void cutHoles() const;

    /// Gives the keyboard to a float, where the widget gets it that had it last, or to any other widget. False for one
    /// that takes no input, and for null.
    static bool giveKeyboard(QWidget* place);

    /// Gives the keyboard of a window to the front-most that takes input, unless somebody who does so has it. Without
    /// one, the window itself takes it.
    void settleKeyboard(QWidget& window) const;

private:
    /// A place in the order. The widget can be deleted by others.
    struct Place
    {
        QPointer<QWidget> widget;
        /// The same; null for what is no float.
        QtFloat* floating;
    };

    /// Lets a float come to the front when a widget in it gets the keyboard: it is to be seen.
    static void watchKeyboard();

    void forget(QWidget const& widget);

    /// `hole` is in the coordinates of the window.
    static void cutHole(QWidget& floating, QRegion const& hole);

    /// The front-most one last. Of the widgets that are no floats, one a window: the one that had the keyboard last.
    std::vector<Place> _places;
};

} // namespace Kv
