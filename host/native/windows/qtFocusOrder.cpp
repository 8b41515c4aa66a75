#include "windows/qtFocusOrder.h"

#include "windows/qtFloat.h"

#include <QLineEdit>
#include <QPushButton>
#include <QScrollArea>

#include <algorithm>
#include <cstdlib>
#include <iterator>

namespace Kv
{

namespace
{

/// A widget and where it stands.
struct Place
{
    QWidget* widget;
    QRect rect;
};

bool takesFocus(QWidget const& widget)
{
    return (widget.focusPolicy() & Qt::TabFocus) && !widget.focusProxy() && QtFocusOrder::canHold(widget);
}

std::vector<QWidget*> findStops(QWidget const& root)
{
    QWidget const* const window = root.window();
    // The widget that has the keyboard counts also if it cannot keep it: the step goes from there.
    QWidget const* const current = window->focusWidget();
    std::vector<QWidget*> stops;
    for (QWidget* const widget : root.findChildren<QWidget*>())
        if (widget->window() == window && (widget == current || takesFocus(*widget)))
            stops.push_back(widget);
    return stops;
}

bool inOneRow(QRect const& a, QRect const& b)
{
    return 2 * std::abs(a.center().y() - b.center().y()) <= std::min(a.height(), b.height());
}

bool isPushButton(QWidget const& widget)
{
    return qobject_cast<QPushButton const*>(&widget);
}

/// Scrolls a widget into view; of one that is larger than the room, its beginning.
void reveal(QScrollArea& area, QWidget const& widget)
{
    // So much of what is around it is seen too: a row of it above and below, and the title that lies over the content.
    constexpr QSize margin(7, 56);
    QSize const half = widget.size().boundedTo(area.viewport()->size() / 2) / 2;
    QPoint const middle = widget.mapTo(area.widget(), QPoint(half.width(), half.height()));
    area.ensureVisible(middle.x(), middle.y(), half.width() + margin.width(), half.height() + margin.height());
}

} // namespace

std::vector<QtFocusOrder::Row> QtFocusOrder::sortIntoRows(std::vector<QWidget*> const& widgets)
{
    std::vector<Place> places;
    places.reserve(widgets.size());
    for (QWidget* const widget : widgets)
        places.push_back({widget, QRect(widget->mapTo(widget->window(), QPoint(0, 0)), widget->size())});
    std::stable_sort(places.begin(), places.end(),
                     [](Place const& a, Place const& b) { return a.rect.center().y() < b.rect.center().y(); });
    std::vector<Row> rows;
    for (auto first = places.begin(); first != places.end();)
    {
        auto const end = std::find_if_not(std::next(first), places.end(),
                                          [&](Place const& place) { return inOneRow(first->rect, place.rect); });
        std::stable_sort(first, end, [](Place const& a, Place const& b) { return a.rect.x() < b.rect.x(); });
        Row& row = rows.emplace_back();
        std::transform(first, end, std::back_inserter(row), [](Place const& place) { return place.widget; });
        first = end;
    }
    return rows;
}

QtFocusOrder::QtFocusOrder(QWidget const& root) : _root(&root)
{
    for (Row const& row : sortIntoRows(findStops(root)))
        _stops.insert(_stops.end(), row.begin(), row.end());
}

bool QtFocusOrder::step(bool next)
{
    QWidget* const target = find(next ? 1 : -1);
    if (!target)
        return false;
    give(*target, next ? Qt::TabFocusReason : Qt::BacktabFocusReason);
    return true;
}

bool QtFocusOrder::holdsValue(QWidget const& widget)
{
    QWidget const* const proxy = widget.focusProxy();
    return dynamic_cast<QtValueWidget const*>(proxy ? proxy : &widget);
}

QWidget* QtFocusOrder::getFirst() const
{
    for (auto const wanted : {&holdsValue, &isPushButton})
        for (QWidget* const widget : _stops)
            if (widget && wanted(*widget) && takesFocus(*widget))
                return widget;
    return nullptr;
}

bool QtFocusOrder::canHold(QWidget const& widget)
{
    return widget.isEnabled() && widget.isVisibleTo(widget.window());
}

void QtFocusOrder::give(QWidget& widget, Qt::FocusReason reason)
{
    widget.setFocus(reason);
    // A window that is not active yet gets the keyboard for another reason, which would neither select nor show.
    widget.window()->setAttribute(Qt::WA_KeyboardFocusChange);
    if (auto* const field = qobject_cast<QLineEdit*>(&widget))
        field->selectAll();
    for (QWidget* parent = widget.parentWidget(); parent; parent = parent->parentWidget())
        if (auto* const area = qobject_cast<QScrollArea*>(parent))
            reveal(*area, widget);
    if (QtFloat const* const floating = QtFloat::findAround(widget))
        floating->askIntoView(widget);
}

bool QtFocusOrder::leadsOn()
{
    QWidget const* const current = _root->window()->focusWidget();
    if (!current)
        return false;
    // As a rule it is where the last step went.
    if (_place >= _stops.size() || _stops[_place] != current)
        _place = static_cast<std::size_t>(std::find(_stops.begin(), _stops.end(), current) - _stops.begin());
    return _place < _stops.size();
}

QWidget* QtFocusOrder::find(int direction)
{
    auto const count = static_cast<int>(_stops.size());
    int const nowhere = direction > 0 ? -1 : count;
    int place = leadsOn() ? static_cast<int>(_place) : nowhere;
    QWidget const* const current = _root->window()->focusWidget();
    for (int steps = 0; steps < count; ++steps)
    {
        place = (place + direction + count) % count;
        QWidget* const widget = _stops[static_cast<std::size_t>(place)];
        if (!widget || widget == current || !takesFocus(*widget))
            continue;
        _place = static_cast<std::size_t>(place);
        return widget;
    }
    return nullptr;
}

} // namespace Kv
