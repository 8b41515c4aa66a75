#include "uiColorRegistry.h"

#include "exBase.h"

namespace Kv
{

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
