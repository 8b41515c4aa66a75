#pragma once

#include "pointers/rcShdPtr.h"
#include "prdPredicate.h"
#include "snItem.h"

#include <list>

namespace Kv
{

/// What was selected at one moment, in the order in which it is shown. Keeps its items; it does not follow later
/// changes.
class KV_API SnSelection : public RCBase<LkCounter<int>>
{
public:
    using Items = std::list<RCShdPtr<const SnItem>>;

    explicit SnSelection(Items items);
    ~SnSelection() override;

    /// A selection of the items that satisfy the predicate, in the same order. Never null.
    virtual RCShdPtr<const SnSelection> filter(PrdPredicate<RCShdPtr<const SnItem>> const& predicate) const;

    Items::const_iterator begin() const;
    Items::const_iterator end() const;

private:
    Items _items;
};

} // namespace Kv
