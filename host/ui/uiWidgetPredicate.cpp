#include "uiWidgetPredicate.h"

namespace Kv
{

RttiType::RttiType(Test test) : _test(test) {}

PrdPredicate<UiWidget> UiWidgetPredicate::isType(RttiType const& type)
{
    return PrdPredicate<UiWidget>([&type](UiWidget const& widget) { return type.isInstance(widget); });
}

PrdPredicate<UiWidget> UiWidgetPredicate::nameStartsWith(std::string const& prefix)
{
    return PrdPredicate<UiWidget>([prefix](UiWidget const& widget)
                                  { return widget.getName().compare(0, prefix.size(), prefix) == 0; });
}

} // namespace Kv
