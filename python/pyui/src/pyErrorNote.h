#pragma once

#include <boost/python/object.hpp>

#include <functional>
#include <string>

namespace Kv::PyextUi
{

/// Makes the text of a note; None where there is nothing to say.
using NoteMaker = std::function<boost::python::object()>;

/// Adds a note to the Python error that is set: Python prints it behind the error's own words. A note that cannot be
/// made is left out.
void addErrorNote(NoteMaker const& makeNote);

/// To be called while an exception is caught: throws it on as the Python error that scripts see of it, with a note.
[[noreturn]] void rethrowWithNote(NoteMaker const& makeNote);

/// Gives what `action` gives. An exception that comes out of it gets a note.
template <typename Action, typename MakeNote> auto withNote(Action action, MakeNote makeNote)
{
    try
    {
        return action();
    }
    catch (...)
    {
        rethrowWithNote(makeNote);
    }
}

/// Says which entry of a list an error is about.
boost::python::object describeEntry(char const* list, int index, boost::python::object const& entry);

// What a widget of each kind takes, for `describeValue`.
inline constexpr char const* textFieldForm = "The text field %r takes a str or None";
inline constexpr char const* toggleButtonForm = "The toggle button %r takes a bool, an int or None";
inline constexpr char const* menuForm = "The menu %r takes a tuple of a list of str and an index, as (['a', 'b'], 0)";
inline constexpr char const* labelForm = "The label %r takes a str or None";

/// Says what the widget of that name takes, and what it was given.
boost::python::object describeValue(char const* form, std::string const& widgetName,
                                    boost::python::object const& value);

} // namespace Kv::PyextUi
