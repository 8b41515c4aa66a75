#pragma once

#include "kvExport.h"
#include "prdPredicate.h"
#include "rttiType.h"
#include "uiWidget.h"

#include <string>

namespace Kv
{

/// Questions about widgets, for searches.
class KV_API UiWidgetPredicate
{
public:
    /// Holds for widgets of the class of that record, and of classes derived from it.
    static PrdPredicate<UiWidget> isType(RttiType const& type);

    /// Holds for widgets whose name starts with `prefix`, or is it.
    static PrdPredicate<UiWidget> nameStartsWith(std::string const& prefix);
};

} // namespace Kv
