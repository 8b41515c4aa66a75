#pragma once

#include "coRgbColor.h"
#include "kvExport.h"
#include "pointers/rcBase.h"
#include "text/liString.h"

namespace Kv
{

/// The edge that is drawn around a widget.
class KV_API UiFrame : public RCBase<LkCounter<int>>
{
public:
    ~UiFrame() override;

    /// True for a frame with a line along its bottom edge.
    virtual bool hasBottomLine() const = 0;
};

/// A frame that is a line along the bottom.
class KV_API UiFrameLineBottom : public UiFrame
{
public:
    UiFrameLineBottom();
    ~UiFrameLineBottom() override;

    bool hasBottomLine() const override;
};

/// The colours by name.
class KV_API UiColorRegistry
{
public:
    /// "grey65": grey of 65 % of the light of white.
    static LiString const Grey65;

    static UiColorRegistry& getInstance();

    /// Throws an `ExBase` for a name that no colour has.
    CoRgbColorTyped<float> getColor(LiString const& name) const;
};

} // namespace Kv
