#pragma once

#include "kvExport.h"
#include "pointers/rcBase.h"
#include "pointers/rcShdPtr.h"
#include "prdPredicate.h"

#include <list>

namespace Kv
{

/// Something that can be selected. What it is, those find out who know its kind, through `SnItemConvert`.
class KV_API SnItem : public RCBase<LkCounter<int>>
{
public:
    ~SnItem() override;
};

/// The way from items of a selection to what `T` points to. Each library that has a kind of item specializes it, with
/// two static operations: `getPredicate`, which holds for the items of that kind, and `get`, which gives what such an
/// item stands for, and null for any other.
template <typename T> class SnItemConvert;

/// The items that were selected at one moment, in the order in which they are shown. Keeps them; it does not follow
/// later changes.
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
