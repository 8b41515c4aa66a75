#pragma once

#include <QWidget>

#include <vector>

namespace Kv
{

/// The floats of the process in the order in which they came to the front. The toolkit stacks only what has one parent:
/// a float in a pane lies beneath each float of the window. One that lies beneath another though it came to the front
/// later is seen through a hole in that.
class FloatStack
{
public:
    static FloatStack& getInstance();

    void bringToFront(QWidget& floating);
    void remove(QWidget& floating);

    /// One of them has been moved, shown or hidden.
    void cutHoles() const;

private:
    /// `hole` is in the coordinates of the window.
    static void cutHole(QWidget& floating, QRegion const& hole);

    /// The uppermost one last.
    std::vector<QWidget*> _floats;
};

} // namespace Kv
