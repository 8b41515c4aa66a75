#include <boost/python.hpp>

#include "pyErrorNote.h"

namespace bp = boost::python;

namespace Kv::PyextUi
{

namespace
{

/// What `add_note` does, which Python has from 3.11 on.
void appendNote(bp::object error, bp::object const& note)
{
    if (!PyObject_HasAttrString(error.ptr(), "__notes__"))
        error.attr("__notes__") = bp::list();
    error.attr("__notes__").attr("append")(note);
}

/// How Python shows an object, in a few words: long texts and lists are cut.
bp::object toShortText(bp::object const& object)
{
    return bp::import("reprlib").attr("repr")(object);
}

} // namespace

void addErrorNote(NoteMaker const& makeNote)
{
    PyObject* type = nullptr;
    PyObject* value = nullptr;
    PyObject* traceback = nullptr;
    PyErr_Fetch(&type, &value, &traceback);
    PyErr_NormalizeException(&type, &value, &traceback);
    try
    {
        bp::object const note = makeNote();
        if (!note.is_none())
            appendNote(bp::object(bp::handle<>(bp::borrowed(value))), note);
    }
    catch (...)
    {
        bp::handle_exception();
        PyErr_Clear();
    }
    PyErr_Restore(type, value, traceback);
}

void rethrowWithNote(NoteMaker const& makeNote)
{
    bp::handle_exception();
    addErrorNote(makeNote);
    throw bp::error_already_set();
}

bp::object describeEntry(char const* list, int index, bp::object const& entry)
{
    return bp::str("Entry [%d] of the %s is %s") % bp::make_tuple(index, list, toShortText(entry));
}

bp::object describeValue(char const* form, std::string const& widgetName, bp::object const& value)
{
    return bp::str(form) % bp::make_tuple(widgetName) + "; it was given " + toShortText(value);
}

} // namespace Kv::PyextUi
