#pragma once

#include <boost/python/object.hpp>

#include "uiWidget.h"

#include <string>

namespace Kv::PyextUi
{

// The values of widgets as scripts see them. The source of this file knows the kinds that have one.

/// The kinds of widgets that a value tells apart.
enum class ValueKind
{
    None,
    Container,
    TextField,
    ToggleButton,
    Menu,
};

ValueKind findValueKind(UiWidget const& widget);

/// True for the kinds that have a value.
constexpr bool hasValue(ValueKind kind)
{
    return kind != ValueKind::None && kind != ValueKind::Container;
}

/// The value of a widget of that kind; None where it has none.
boost::python::object readValue(UiWidget const& widget, ValueKind kind);

/// The fate of the entries that a menu has when it is written.
enum class MenuEntries
{
    Replace,
    Add,
};

/// Writes the value of a widget of that kind, where it has one. A value of the wrong form is a Python error with a note
/// of the right one.
void writeValue(UiWidget& widget, ValueKind kind, boost::python::object const& value, MenuEntries mode,
                bool invokeCallback);

/// Says what the widget of that name takes, and what it was given. `kind` is the kind's name in a description.
boost::python::object describeValue(std::string const& kind, std::string const& widgetName,
                                    boost::python::object const& value);

} // namespace Kv::PyextUi
