#pragma once

#include <boost/python/object.hpp>

#include "pointers/rcShdPtr.h"
#include "uiWidget.h"

#include <string>

namespace Kv::PyextUi
{

// The values of widgets as scripts see them. The source of this file knows the kinds that have one.

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

/// Says what the widget of that name takes, and what it was given. `kind` is the kind's name in a description.
boost::python::object describeValue(std::string const& kind, std::string const& widgetName,
                                    boost::python::object const& value);

} // namespace Kv::PyextUi
