#include "windows/qtCaptions.h"

#include "peers/qtLabel.h"
#include "windows/qtFocusOrder.h"

#include <algorithm>
#include <unordered_map>
#include <vector>

namespace Kv
{

namespace
{

using Row = QtFocusOrder::Row;

QtLabel* toLabel(QWidget& widget)
{
    return dynamic_cast<QtLabel*>(&widget);
}

/// Leaves out the labels that are not displayed, in a row where another one is.
void dropHiddenLabels(Row& row)
{
    auto const isHidden = [](QWidget* widget) { return toLabel(*widget) && widget->isHidden(); };
    if (std::any_of(row.begin(), row.end(), [](QWidget* widget) { return toLabel(*widget) && !widget->isHidden(); }))
        row.erase(std::remove_if(row.begin(), row.end(), isHidden), row.end());
}

/// Finds the labels of the values in one row, and says of each label and value that belong together so.
template <typename Say> void matchRow(Row const& row, Say const& say)
{
    auto const labelAt = [&row](std::size_t place) { return place < row.size() ? toLabel(*row[place]) : nullptr; };
    auto const isValueAt = [&row](std::size_t place)
    { return place < row.size() && QtFocusOrder::holdsValue(*row[place]); };
    QtLabel* left = nullptr;
    for (std::size_t place = 0; place < row.size(); ++place)
    {
        if (QtLabel* const label = labelAt(place))
            left = label;
        if (!isValueAt(place))
            continue;
        QtLabel* const right = labelAt(place + 1);
        bool const isBeside = place > 0 && labelAt(place - 1) && labelAt(place - 1) == left;
        if (right && !isBeside && (!left || !isValueAt(place + 2)))
        {
            say(*right, *row[place]);
            // It is for this one alone.
            ++place;
        }
        else if (left)
            say(*left, *row[place]);
    }
}

} // namespace

void nameValuesIn(QWidget const& root)
{
    std::unordered_map<QtLabel*, QWidget*> named;
    std::vector<QWidget*> widgets;
    for (QWidget* const widget : root.findChildren<QWidget*>())
    {
        QtLabel* const label = toLabel(*widget);
        if (label)
            named.emplace(label, nullptr);
        if (label ? !label->getWords().isEmpty() : QtFocusOrder::holdsValue(*widget))
            widgets.push_back(widget);
    }
    for (Row& row : QtFocusOrder::sortIntoRows(widgets))
    {
        dropHiddenLabels(row);
        matchRow(row,
                 [&named](QtLabel& label, QWidget& value)
                 {
                     value.setAccessibleName(label.getWords());
                     QWidget*& first = named[&label];
                     first = first ? first : &value;
                 });
    }
    for (auto const& [label, value] : named)
        label->setNamed(value);
}

} // namespace Kv
