#include "uiWidgetPredicate.h"

namespace Kv
{

PrdPredicate<UiWidget> UiWidgetPredicate::isType(RttiType const& type)
{
    return PrdPredicate<UiWidget>([&type](UiWidget const& widget) { return widget.getRttiType().isA(type); });
}

PrdPredicate<UiWidget> UiWidgetPredicate::nameStartsWith(std::string const& prefix)
{
    return PrdPredicate<UiWidget>([prefix](UiWidget const& widget)
                                  { return widget.getName().compare(0, prefix.size(), prefix) == 0; });
}

} // namespace Kv
