#pragma once

#include "base/rcBase.h"

namespace Kv
{

/// What is drawn around a widget.
class UiFrame : public RCBase<LkCounter<int>>
{
public:
    /// True for a frame with a line along its bottom edge.
    virtual bool hasBottomLine() const = 0;
};

/// A frame that is a line along the bottom.
class UiFrameLineBottom : public UiFrame
{
public:
    bool hasBottomLine() const override { return true; }
};

} // namespace Kv
