#include "uiLook.h"

#include "exBase.h"

namespace Kv
{

UiFrame::~UiFrame() = default;

UiFrameLineBottom::UiFrameLineBottom() = default;

UiFrameLineBottom::~UiFrameLineBottom() = default;

bool UiFrameLineBottom::hasBottomLine() const
{
    return true;
}

LiString const UiColorRegistry::Grey65("grey65");

UiColorRegistry& UiColorRegistry::getInstance()
{
    static UiColorRegistry registry;
    return registry;
}

CoRgbColorTyped<float> UiColorRegistry::getColor(LiString const& name) const
{
    if (name != Grey65)
        throw ExBase(__FILE__, __LINE__, "Unknown colour \"" + name.toString() + "\"");
    constexpr float level = 0.65F;
    return {level, level, level};
}

} // namespace Kv
