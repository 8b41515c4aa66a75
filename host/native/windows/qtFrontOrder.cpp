#include "windows/qtFrontOrder.h"

#include "windows/qtFloat.h"
#include "windows/qtFocusOrder.h"

#include <QRegion>

#include <algorithm>

namespace Kv
{

namespace
{

/// The part of a float that is in sight unless something lies above it, in the coordinates of its window.
QRect getVisibleRect(QWidget const& floating)
{
    QWidget const& parent = *floating.parentWidget();
    QRect const seen = floating.geometry().intersected(parent.rect());
    return seen.translated(parent.mapTo(floating.window(), QPoint(0, 0)));
}

/// Null for what is no float, or gone.
QtFloat* toFloat(QWidget* widget)
{
    return dynamic_cast<QtFloat*>(widget);
}

} // namespace

QtFrontOrder& QtFrontOrder::getInstance()
{
    // Never destroyed: floats go as late as the last objects of the interpreter do.
    static auto* const order = new QtFrontOrder;
    return *order;
}

void QtFrontOrder::bringToFront(QtFloat& floating)
{
    floating.raise();
    forget(floating);
    _places.emplace_back(&floating);
    cutHoles();
}

void QtFrontOrder::remove(QtFloat& floating)
{
    forget(floating);
    cutHoles();
}

void QtFrontOrder::rememberKeyboard(QWidget& widget)
{
    for (QPointer<QWidget> const& place : _places)
        if (place && !toFloat(place) && place->window() == widget.window())
        {
            forget(*place);
            break;
        }
    _places.emplace_back(&widget);
}

void QtFrontOrder::cutHoles() const
{
    for (auto lower = _places.begin(); lower != _places.end(); ++lower)
    {
        QtFloat* const floating = toFloat(*lower);
        QWidget const* const window = floating ? floating->parentWidget() : nullptr;
        if (!window || !window->isWindow())
            continue;
        QRegion hole;
        for (auto place = lower + 1; place != _places.end(); ++place)
            if (QtFloat const* const upper = toFloat(*place);
                upper && upper->isVisible() && upper->window() == window && upper->parentWidget() != window)
                hole += getVisibleRect(*upper);
        cutHole(*floating, hole);
    }
}

bool QtFrontOrder::giveKeyboard(QWidget* place)
{
    if (!place || !QtFocusOrder::canHold(*place))
        return false;
    if (QtFloat* const floating = toFloat(place))
        floating->resumeKeyboard();
    else
        place->setFocus(Qt::OtherFocusReason);
    return true;
}

void QtFrontOrder::settleKeyboard(QWidget& window) const
{
    QWidget const* const withKeyboard = window.focusWidget();
    if (withKeyboard && withKeyboard != &window && QtFocusOrder::canHold(*withKeyboard))
        return;
    // A copy: who gets the keyboard comes to the front.
    std::vector<QPointer<QWidget>> const places = _places;
    auto const takesIt = [&window](QPointer<QWidget> const& place)
    { return place && place->window() == &window && giveKeyboard(place); };
    if (std::find_if(places.rbegin(), places.rend(), takesIt) == places.rend())
        window.setFocus(Qt::OtherFocusReason);
}

void QtFrontOrder::forget(QWidget const& widget)
{
    _places.erase(std::remove_if(_places.begin(), _places.end(),
                                 [&widget](QPointer<QWidget> const& place) { return !place || place == &widget; }),
                  _places.end());
}

void QtFrontOrder::cutHole(QWidget& floating, QRegion const& hole)
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
