#include <boost/python.hpp>

#include "pyUiError.h"

#include "pythonError.h"

#include <algorithm>
#include <map>

namespace bp = boost::python;

namespace Kv::PyextUi
{

namespace
{

/// A note whose middle goes where nobody would read it to its end.
bp::object shorten(bp::object const& note)
{
    constexpr long half = ExBase::mostBytes / 2;
    if (bp::len(note) <= 2 * half)
        return note;
    return note.slice(0, half) + bp::str(" … ") + note.slice(-half, bp::_);
}

/// Does the work of `add_note`, which Python has from 3.11 on.
void appendNote(bp::object error, bp::object const& note)
{
    if (!PyObject_HasAttrString(error.ptr(), "__notes__"))
        error.attr("__notes__") = bp::list();
    error.attr("__notes__").attr("append")(shorten(note));
}

} // namespace

void addErrorNote(NoteMaker const& makeNote)
{
    PythonError const error = PythonError::fetch();
    try
    {
        bp::object const note = makeNote();
        if (!note.is_none())
            appendNote(bp::object(bp::handle<>(bp::borrowed(error.getException()))), note);
    }
    catch (...)
    {
        bp::handle_exception();
        PyErr_Clear();
    }
    error.restore();
}

void rethrowWithNote(NoteMaker const& makeNote)
{
    bp::handle_exception();
    addErrorNote(makeNote);
    throw bp::error_already_set();
}

bp::object toShortText(bp::object const& object)
{
    return bp::import("reprlib").attr("repr")(object);
}

bp::object describeEntry(char const* list, int index, bp::object const& entry)
{
    return bp::str("Entry [%d] of the %s is %s") % bp::make_tuple(index, list, toShortText(entry));
}

namespace
{

using Names = std::vector<std::string>;

/// The names of the parameters, by function. A function that is gone leaves its entry to the next at its place.
std::map<PyObject*, Names>& getParameters()
{
    static std::map<PyObject*, Names> parameters;
    return parameters;
}

std::string join(Names const& names)
{
    std::string text;
    for (std::size_t i = 0; i < names.size(); ++i)
        text += (i == 0 ? "" : i + 1 < names.size() ? ", " : " and ") + names[i];
    return text;
}

/// The fault of `given`, arguments by name behind `count` ones by place; empty if there is none.
std::string findFault(Names const& parameters, std::size_t count, Names const& given)
{
    if (parameters.empty())
        return "All arguments go by place";
    Names named(parameters);
    named.erase(std::remove(named.begin(), named.end(), ""), named.end());
    auto last = parameters.begin();
    for (std::string const& name : given)
    {
        auto const place = std::find(parameters.begin(), parameters.end(), name);
        if (place == parameters.end())
            return "No argument goes by the name " + name + ": those that do are " + join(named);
        if (place < parameters.begin() + static_cast<std::ptrdiff_t>(count))
            return name + " is there by place already";
        last = std::max(last, place);
    }
    std::size_t const required = parameters.size() - named.size();
    if (count < required)
        return "The first " + std::to_string(required) + " arguments go by place";
    Names missing;
    for (auto place = parameters.begin() + static_cast<std::ptrdiff_t>(count); place < last; ++place)
        if (std::find(given.begin(), given.end(), *place) == given.end())
            missing.push_back(*place);
    return missing.empty() ? "" : *last + " by name needs " + join(missing) + " too";
}

bp::object describeFault(PyObject* function, PyObject* arguments, PyObject* keywords)
{
    Names given;
    bp::list const names(bp::dict(bp::handle<>(bp::borrowed(keywords))).keys());
    for (int i = 0; i < bp::len(names); ++i)
        given.push_back(bp::extract<std::string>(names[i]));
    std::string const fault =
        findFault(getParameters().at(function), static_cast<std::size_t>(PyTuple_Size(arguments)), given);
    return fault.empty() ? bp::object() : bp::object(fault);
}

/// False, with the error set, for an argument whose `__class__` raises. Boost.Python would take it for a list or a
/// dict, and make the call with the error set.
bool hasClass(PyObject* argument)
{
    if (!PyType_HasFeature(Py_TYPE(argument), Py_TPFLAGS_HEAPTYPE))
        return true;
    static PyObject* const name = PyUnicode_InternFromString("__class__");
    PyObject* const type = PyObject_GetAttr(argument, name);
    Py_XDECREF(type);
    return type;
}

bool haveClasses(PyObject* arguments, PyObject* keywords)
{
    for (Py_ssize_t i = 0; i < PyTuple_GET_SIZE(arguments); ++i)
        if (!hasClass(PyTuple_GET_ITEM(arguments, i)))
            return false;
    PyObject* value = nullptr;
    for (Py_ssize_t place = 0; keywords && PyDict_Next(keywords, &place, nullptr, &value);)
        if (!hasClass(value))
            return false;
    return true;
}

PyObject* callAndExplain(PyObject* function, PyObject* arguments, PyObject* keywords)
{
    if (!haveClasses(arguments, keywords))
        return nullptr;
    PyObject* const result = Py_TYPE(function)->tp_base->tp_call(function, arguments, keywords);
    if (!result && keywords)
        addErrorNote([&] { return describeFault(function, arguments, keywords); });
    return result;
}

/// Makes the signature that `inspect` asks for of what the docstring says of the parameters. `names` are those that can
/// go by name; a function that has none is a method.
bp::object makeSignature(bp::object const& function, Names const& names)
{
    bp::object const inspect = bp::import("inspect");
    bp::object const make = inspect.attr("Parameter");
    bp::object const byPlace = make.attr("POSITIONAL_ONLY");
    bp::list parameters;
    if (names.empty())
        parameters.append(make("self", byPlace));
    bp::object const findAll = bp::import("re").attr("findall");
    bp::list const found(findAll(R"((?s)@param (\w+):(.*?)(?=\n@|$))", bp::object(function.attr("__doc__"))));
    for (int i = 0; i < bp::len(found); ++i)
    {
        std::string const name = bp::extract<std::string>(found[i][0]);
        bool const goesByName = std::find(names.begin(), names.end(), name) != names.end();
        bp::dict options;
        bp::list const defaults(findAll(R"(Default(?:s to| is) (?:C\{(\w+)\}|(\S+))\.\s*$)", bp::object(found[i][1])));
        if (bp::len(defaults) > 0)
            options["default"] = bp::eval(bp::str("").join(defaults[0]), bp::import("builtins").attr("__dict__"));
        bp::object const kind = goesByName ? make.attr("POSITIONAL_OR_KEYWORD") : byPlace;
        parameters.append(make(*bp::make_tuple(name, kind), **options));
    }
    return inspect.attr("Signature")(parameters);
}

PyObject* getSignature(PyObject* function, void*)
{
    try
    {
        bp::object const itself(bp::handle<>(bp::borrowed(function)));
        return bp::incref(makeSignature(itself, getParameters().at(function)).ptr());
    }
    catch (bp::error_already_set const&)
    {
        return nullptr;
    }
}

/// The type of Boost.Python's functions, but for what a call does when it has failed, and for the signature.
PyTypeObject* getExplainedType(PyTypeObject* base)
{
    static PyTypeObject type{};
    if (!type.tp_base)
    {
        Py_SET_REFCNT(&type, 1);
        type.tp_name = base->tp_name;
        type.tp_base = base;
        type.tp_flags = Py_TPFLAGS_DEFAULT;
        type.tp_call = &callAndExplain;
        // Not inherited: a type has a docstring of its own, which would hide that of the function.
        static std::vector<PyGetSetDef> attributes;
        for (PyGetSetDef const* one = base->tp_getset; one && one->name; ++one)
            attributes.push_back(*one);
        attributes.push_back({"__signature__", &getSignature, nullptr, nullptr, nullptr});
        attributes.push_back({});
        type.tp_getset = attributes.data();
        if (PyType_Ready(&type) != 0)
            bp::throw_error_already_set();
    }
    return &type;
}

} // namespace

void explainArguments(bp::object const& function, Names const& parameters)
{
    Py_SET_TYPE(function.ptr(), getExplainedType(Py_TYPE(function.ptr())));
    getParameters()[function.ptr()] = parameters;
}

void explainMethods(bp::object const& type)
{
    bp::list const names(type.attr("__dict__").attr("keys")());
    for (int i = 0; i < bp::len(names); ++i)
    {
        bp::object const method = type.attr("__dict__")[names[i]];
        if (std::string(Py_TYPE(method.ptr())->tp_name) == "Boost.Python.function" && method.attr("__doc__"))
            explainArguments(method, {});
    }
}

} // namespace Kv::PyextUi

template class Kv::PyextInit::ModError<Kv::PyextUi::Ui>;
