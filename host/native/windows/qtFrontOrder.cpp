#include "windows/qtFrontOrder.h"

#include "loop/qtGuard.h"
#include "windows/qtFloat.h"
#include "windows/qtFocusOrder.h"

#include <QApplication>
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

} // namespace

QtFrontOrder& QtFrontOrder::getInstance()
{
    // Never destroyed: floats go as late as the last objects of the interpreter do.
    static auto* const order = new QtFrontOrder;
    return *order;
}

void QtFrontOrder::bringToFront(QtFloat& floating)
{
    watchKeyboard();
    floating.raise();
    if (!_places.empty() && _places.back().widget == &floating)
        return;
    forget(floating);
    _places.push_back({&floating, &floating});
    cutHoles();
}

QtFloat* QtFrontOrder::getFront() const
{
    auto const front = std::find_if(_places.rbegin(), _places.rend(),
                                    [](Place const& place) { return place.floating && place.widget; });
    return front == _places.rend() ? nullptr : front->floating;
}

void QtFrontOrder::remove(QtFloat& floating)
{
    forget(floating);
    // It is being destroyed, and nothing may come out of that.
    QtGuard::getInstance().shield([this] { cutHoles(); });
}

void QtFrontOrder::rememberKeyboard(QWidget& widget)
{
    for (Place const& place : _places)
        if (place.widget && !place.floating && place.widget->window() == widget.window())
        {
            forget(*place.widget);
            break;
        }
    _places.push_back({&widget, nullptr});
}

void QtFrontOrder::cutHoles() const
{
    for (auto lower = _places.begin(); lower != _places.end(); ++lower)
    {
        QWidget const* const window = lower->widget && lower->floating ? lower->widget->parentWidget() : nullptr;
        if (!window || !window->isWindow())
            continue;
        QRegion hole;
        for (auto place = lower + 1; place != _places.end(); ++place)
            if (QWidget const* const upper = place->floating ? place->widget.data() : nullptr;
                upper && upper->isVisible() && upper->window() == window && upper->parentWidget() != window)
                hole += getVisibleRect(*upper);
        cutHole(*lower->widget, hole);
    }
}

bool QtFrontOrder::giveKeyboard(QWidget* place)
{
    if (!place || !QtFocusOrder::canHold(*place))
        return false;
    if (auto* const floating = dynamic_cast<QtFloat*>(place))
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
    std::vector<Place> const places = _places;
    auto const takesIt = [&window](Place const& place)
    { return place.widget && place.widget->window() == &window && giveKeyboard(place.widget); };
    if (std::find_if(places.rbegin(), places.rend(), takesIt) == places.rend())
        window.setFocus(Qt::OtherFocusReason);
}

void QtFrontOrder::watchKeyboard()
{
    static QPointer<QCoreApplication> watched;
    if (watched == QCoreApplication::instance())
        return;
    watched = QCoreApplication::instance();
    QObject::connect(qApp, &QApplication::focusChanged, qApp,
                     [](QWidget* from, QWidget* to)
                     {
                         QtFloat* const floating = to ? QtFloat::findAround(*to) : nullptr;
                         if (floating && floating != to && !(from && floating->isAncestorOf(from)))
                             getInstance().bringToFront(*floating);
                     });
}

void QtFrontOrder::forget(QWidget const& widget)
{
    _places.erase(std::remove_if(_places.begin(), _places.end(),
                                 [&widget](Place const& place) { return !place.widget || place.widget == &widget; }),
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
