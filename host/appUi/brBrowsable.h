#pragma once

#include "kvExport.h"
#include "pointers/rcBase.h"
#include "pointers/rcShdPtr.h"
#include "prdPredicate.h"
#include "snSelection.h"
#include "text/liString.h"

namespace Kv
{

/// A file or a directory for which a browser has an entry. It need not exist any more.
class KV_API BrBrowsable : public RCBase<LkCounter<int>>
{
public:
    explicit BrBrowsable(LiString path);
    ~BrBrowsable() override;

    /// The path of its place in the browser's scheme; of a file the absolute path, in the bytes of the file system.
    virtual LiString getPath() const;

private:
    LiString _path;
};

/// A browsable as part of a selection.
class KV_API BrBrowsableItem : public SnItem
{
public:
    /// `browsable` is not null.
    explicit BrBrowsableItem(RCShdPtr<BrBrowsable> browsable);
    ~BrBrowsableItem() override;

    RCShdPtr<BrBrowsable> const& getBrowsable() const { return _browsable; }

private:
    RCShdPtr<BrBrowsable> _browsable;
};

/// The browsables in a selection.
template <> class KV_API SnItemConvert<RCShdPtr<BrBrowsable>>
{
public:
    /// Holds for items that stand for a browsable.
    static PrdPredicate<RCShdPtr<const SnItem>> getPredicate();

    /// The browsable of an item; null if it stands for something else.
    static RCShdPtr<BrBrowsable> get(RCShdPtr<const SnItem> const& item);
};

} // namespace Kv
