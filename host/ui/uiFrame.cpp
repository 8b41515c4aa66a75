#include "uiFrame.h"

namespace Kv
{

UiFrame::~UiFrame() = default;

UiFrameLineBottom::UiFrameLineBottom() = default;

UiFrameLineBottom::~UiFrameLineBottom() = default;

bool UiFrameLineBottom::hasBottomLine() const
{
    return true;
}

} // namespace Kv
