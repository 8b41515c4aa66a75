#include "brBrowsable.h"

#include <utility>

namespace Kv
{

BrBrowsable::BrBrowsable(LiString path) : _path(std::move(path)) {}

BrBrowsable::~BrBrowsable() = default;

LiString BrBrowsable::getPath() const
{
    return _path;
}

BrBrowsableItem::BrBrowsableItem(RCShdPtr<BrBrowsable> browsable) : _browsable(std::move(browsable)) {}

BrBrowsableItem::~BrBrowsableItem() = default;

PrdPredicate<RCShdPtr<const SnItem>> SnItemConvert<RCShdPtr<BrBrowsable>>::getPredicate()
{
    return PrdPredicate<RCShdPtr<const SnItem>>([](RCShdPtr<const SnItem> const& item) { return !get(item).isNull(); });
}

RCShdPtr<BrBrowsable> SnItemConvert<RCShdPtr<BrBrowsable>>::get(RCShdPtr<const SnItem> const& item)
{
    RCShdPtr<const BrBrowsableItem> const browsableItem = dynamicCast<const BrBrowsableItem>(item);
    return browsableItem ? browsableItem->getBrowsable() : nullptr;
}

} // namespace Kv
