#include "snSelection.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace Kv
{

SnItem::~SnItem() = default;

SnSelection::SnSelection(Items items) : _items(std::move(items)) {}

SnSelection::~SnSelection() = default;

RCShdPtr<const SnSelection> SnSelection::filter(PrdPredicate<RCShdPtr<const SnItem>> const& predicate) const
{
    Items kept;
    std::copy_if(_items.begin(), _items.end(), std::back_inserter(kept),
                 [&predicate](RCShdPtr<const SnItem> const& item) { return predicate.holds(item); });
    return makeShd<SnSelection>(std::move(kept));
}

SnSelection::Items::const_iterator SnSelection::begin() const
{
    return _items.begin();
}

SnSelection::Items::const_iterator SnSelection::end() const
{
    return _items.end();
}

} // namespace Kv
