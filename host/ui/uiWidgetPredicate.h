#pragma once

#include "kvExport.h"
#include "prdPredicate.h"
#include "uiWidget.h"

#include <string>

namespace Kv
{

/// Record of a class of widgets: tells those of that class, and of classes derived from it.
class KV_API RttiType
{
public:
    using Test = bool (*)(UiWidget const& widget);

    explicit RttiType(Test test);

    bool isInstance(UiWidget const& widget) const { return _test(widget); }

private:
    Test _test;
};

/// The record of the class `T`, whose base is `Base`.
template <typename T, typename Base> class RttiGenType1
{
public:
    static RttiType const& getInstance()
    {
        static RttiType const record([](UiWidget const& widget)
                                     { return dynamic_cast<T const*>(static_cast<Base const*>(&widget)) != nullptr; });
        return record;
    }
};

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
