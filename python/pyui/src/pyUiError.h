#pragma once

#include <boost/python/object.hpp>

#include "kvExport.h"
#include "pyModError.h"

#include <functional>
#include <string>
#include <vector>

namespace Kv::PyextUi
{

/// Stands for this module where a template asks which one.
class KV_API Ui;

/// The module's own failures. Scripts see them as `UiError`.
using UiError = PyextInit::ModError<Ui>;

/// Makes the text of a note; None where there is nothing to say.
using NoteMaker = std::function<boost::python::object()>;

/// Adds a note to the Python error that is set: Python prints it behind the error's own words. A note that cannot be
/// made is left out.
void addErrorNote(NoteMaker const& makeNote);

/// Throws the exception that is caught right now on, as the Python error that scripts see of it and with a note.
[[noreturn]] void rethrowWithNote(NoteMaker const& makeNote);

/// Runs `action` and gives its result. An exception that comes out of it gets a note.
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

/// A short text that shows an object: long texts and lists are cut.
boost::python::object toShortText(boost::python::object const& object);

/// Names the entry of a list that an error is about.
boost::python::object describeEntry(char const* list, int index, boost::python::object const& entry);

/// Runs `action` for each index below `count`. An exception that comes out of it gets a note of the entry.
template <typename Action>
void forEachEntry(boost::python::object const& list, int count, char const* listName, Action action)
{
    for (int i = 0; i < count; ++i)
        withNote([&] { action(i); }, [&] { return describeEntry(listName, i, list[i]); });
}

/// Lets a function of Boost.Python say in a note why it refuses the arguments by name that it was given, and tell its
/// signature, as its docstring has it. `parameters` are the names of its parameters in order, empty for those that go
/// by place. Without any, all go by place, behind the object that it is a method of.
void explainArguments(boost::python::object const& function, std::vector<std::string> const& parameters);

/// The same for all methods of a class that have a docstring.
void explainMethods(boost::python::object const& type);

} // namespace Kv::PyextUi

// One set of statics for all libraries.
extern template class KV_API Kv::PyextInit::ModError<Kv::PyextUi::Ui>;
