#pragma once

#include "kvExport.h"
#include "pointers/rcBase.h"

namespace Kv
{

/// What is drawn around a widget.
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

} // namespace Kv
