#include "native/floatStack.h"

#include <QRegion>

#include <algorithm>

namespace Kv
{

namespace
{

/// What of a float is in sight unless something lies above it, in the coordinates of its window.
QRect getVisibleRect(QWidget const& floating)
{
    QWidget const& parent = *floating.parentWidget();
    QRect const seen = floating.geometry().intersected(parent.rect());
    return seen.translated(parent.mapTo(floating.window(), QPoint(0, 0)));
}

} // namespace

FloatStack& FloatStack::getInstance()
{
    // Never destroyed: floats go as late as the last objects of the interpreter do.
    static auto* const stack = new FloatStack;
    return *stack;
}

void FloatStack::bringToFront(QWidget& floating)
{
    floating.raise();
    _floats.erase(std::remove(_floats.begin(), _floats.end(), &floating), _floats.end());
    _floats.push_back(&floating);
    cutHoles();
}

void FloatStack::remove(QWidget& floating)
{
    _floats.erase(std::remove(_floats.begin(), _floats.end(), &floating), _floats.end());
    cutHoles();
}

void FloatStack::cutHoles() const
{
    for (auto lower = _floats.begin(); lower != _floats.end(); ++lower)
    {
        QWidget const* const window = (*lower)->parentWidget();
        if (!window->isWindow())
            continue;
        QRegion hole;
        for (auto upper = lower + 1; upper != _floats.end(); ++upper)
            if ((*upper)->isVisible() && (*upper)->window() == window && (*upper)->parentWidget() != window)
                hole += getVisibleRect(**upper);
        cutHole(**lower, hole);
    }
}

void FloatStack::cutHole(QWidget& floating, QRegion const& hole)
{
    QRegion const whole = floating.rect();
    if (whole.isEmpty() || hole.isEmpty())
    {
        floating.clearMask();
        return;
    }
    QRegion const left = whole.subtracted(hole.translated(-floating.mapTo(floating.window(), QPoint(0, 0))));
    if (left == whole)
        floating.clearMask();
    else
        floating.setMask(left);
}

} // namespace Kv
