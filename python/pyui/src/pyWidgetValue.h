#pragma once

#include <boost/python/object.hpp>

#include "pointers/rcShdPtr.h"
#include "uiWidget.h"

#include <string>

namespace Kv::PyextUi
{

// The values of widgets as scripts see them. All that depends on the kind of widget stands in the source of this file.

/// True for a widget of a kind that has a value.
bool hasValue(RCShdPtr<UiWidget> const& widget);

/// The value of a widget that has one.
boost::python::object readValue(RCShdPtr<UiWidget> const& widget);

/// The fate of the entries that a menu has when it is written.
enum class MenuEntries
{
    Replace,
    Add,
};

/// Writes the value of a widget that has one. A value of the wrong form is a Python error with a note of the right one.
void writeValue(RCShdPtr<UiWidget> const& widget, boost::python::object const& value, MenuEntries mode,
                bool invokeCallback);

// The forms of the values, for `describeValue`.
inline constexpr char const* textFieldForm = "The text field %r takes a str or None";
inline constexpr char const* toggleButtonForm = "The toggle button %r takes a bool, an int or None";
inline constexpr char const* menuForm = "The menu %r takes a tuple of a list of str and an index, as (['a', 'b'], 0)";
inline constexpr char const* labelForm = "The label %r takes a str or None";

/// Says what the widget of that name takes, and what it was given.
boost::python::object describeValue(char const* form, std::string const& widgetName,
                                    boost::python::object const& value);

} // namespace Kv::PyextUi
