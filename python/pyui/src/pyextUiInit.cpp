#include <boost/python.hpp>

#include "appUi/uiAppMgr.h"
#include "pyCompat.h"
#include "pyConvenienceFunctions.h"
#include "pyDialogHolder.h"
#include "pyUiError.h"
#include "pyextUiDocs.h"

#include <string>

namespace bp = boost::python;

namespace Kv::PyextUi
{

namespace
{

/// Boost.Python binds a keyword list to the last parameters of an overload and takes its last name away for each
/// overload that has a parameter less. The list names every parameter, the positional ones with nothing: one that is
/// shorter ends the process when a script passes another parameter by name.
bp::arg positional()
{
    return bp::arg("");
}

RCShdPtr<ManagedDialog> createDialogDefaults(std::string const& title, std::string const& xmlString, int width = -1,
                                             int height = -1, bp::dict const& initialValues = bp::dict())
{
    return createDialog(title, xmlString, width, height, initialValues);
}

bp::dict showDialogDefaults(std::string const& title, std::string const& xmlFile, int width = -1, int height = -1,
                            bp::dict const& initialValues = bp::dict())
{
    return showDialog(title, xmlFile, width, height, initialValues);
}

bp::dict showSimpleDialogDefaults(std::string const& title, bp::list const& widgets, int width,
                                  bool cancelButton = false, bp::dict const& initialValues = bp::dict())
{
    return showSimpleDialog(title, widgets, width, cancelButton, initialValues);
}

std::string showMessageBoxDefaults(std::string const& title, bp::list const& messages,
                                   bp::list const& closeButtons = bp::list())
{
    return showMessageBox(title, messages, closeButtons);
}

std::string makeXmlDefaults(bp::list const& widgets, bp::list const& closeButtons = bp::list())
{
    return makeXmlFromWidgetList(widgets, closeButtons);
}

BOOST_PYTHON_FUNCTION_OVERLOADS(createDialogOverloads, createDialogDefaults, 2, 5)
BOOST_PYTHON_FUNCTION_OVERLOADS(showDialogOverloads, showDialogDefaults, 2, 5)
BOOST_PYTHON_FUNCTION_OVERLOADS(showSimpleDialogOverloads, showSimpleDialogDefaults, 3, 5)
BOOST_PYTHON_FUNCTION_OVERLOADS(showMessageBoxOverloads, showMessageBoxDefaults, 2, 3)
BOOST_PYTHON_FUNCTION_OVERLOADS(makeXmlOverloads, makeXmlDefaults, 1, 2)

void instantiateAppMgr()
{
    UiAppMgr::getInstance();
}

/// Without it the converters for what the graph module hands out do not exist.
bp::handle<> importGraphModule()
{
    std::string const name = "libKVpyextGraph";
    std::string const fullName = "quorvane_velmora.libs." + name;
    auto const import = [](std::string const& moduleName)
    { return PyImport_ImportModuleLevel(moduleName.c_str(), nullptr, nullptr, nullptr, PyCompat::importLevel); };
    PyObject* module = import(fullName);
    if (!module)
    {
        PyErr_Clear();
        module = import(name);
    }
    if (!module)
        bp::throw_error_already_set();
    return bp::handle<>(module);
}

/// The package and the bare name are two modules of one process, and the body runs for each. They share one class for
/// each type, so that what a script has from the one is good for the other. True if the class is there already.
template <typename T> bool shareClass(char const* name)
{
    bp::converter::registration const* const known = bp::converter::registry::query(bp::type_id<T>());
    if (!known || !known->m_class_object)
        return false;
    bp::scope().attr(name) = bp::object(bp::handle<>(bp::borrowed(known->m_class_object)));
    return true;
}

void defineFunctions()
{
    using bp::arg;
    bp::def("showDialog", &showDialogDefaults,
            showDialogOverloads((positional(), positional(), arg("width"), arg("height"), arg("initialValues")),
                                Docs::showDialog));
    bp::def(
        "showSimpleDialog", &showSimpleDialogDefaults,
        showSimpleDialogOverloads((positional(), positional(), positional(), arg("cancelButton"), arg("initialValues")),
                                  Docs::showSimpleDialog));
    bp::def("showMessageBox", &showMessageBoxDefaults,
            showMessageBoxOverloads((positional(), positional(), arg("closeButtons")), Docs::showMessageBox));
    bp::def("makeXmlFromWidgetList", &makeXmlDefaults,
            makeXmlOverloads((positional(), arg("closeButtons")), Docs::makeXmlFromWidgetList));
    bp::def("createDialog", &createDialogDefaults,
            createDialogOverloads((positional(), positional(), arg("width"), arg("height"), arg("initialValues")),
                                  Docs::createDialog));
}

void registerEventType()
{
    if (shareClass<PiWidget::EventType>("EventType"))
        return;
    bp::enum_<PiWidget::EventType>("EventType")
        .value("ENABLE", PiWidget::Enable)
        .value("DISABLE", PiWidget::Disable)
        .value("STATE", PiWidget::State)
        .value("ACTIVATE", PiWidget::Activate)
        .value("VALUE_CHANGED", PiWidget::ValueChanged);
}

void registerDialog()
{
    using SetValue = void (Dialog::*)(std::string const&, bp::object const&);
    using SetValueNotifying = void (Dialog::*)(std::string const&, bp::object const&, bool);
    using SetValues = void (Dialog::*)(bp::dict const&);
    using SetValuesNotifying = void (Dialog::*)(bp::dict const&, bool);
    if (shareClass<Dialog>("Dialog"))
        return;
    bp::class_<Dialog, RCShdPtr<ManagedDialog>, boost::noncopyable> dialog("Dialog", Docs::dialog, bp::no_init);
    supportGarbageCollection(reinterpret_cast<PyTypeObject*>(dialog.ptr()));
    dialog.def("launch", &Dialog::launch, Docs::launch)
        .def("getValue", &Dialog::getValue, Docs::getValue)
        .def("getValues", &Dialog::getValues, Docs::getValues)
        .def("setValue", SetValueNotifying(&Dialog::setValue), Docs::setValue)
        .def("setValue", SetValue(&Dialog::setValue))
        .def("setValues", SetValuesNotifying(&Dialog::setValues), Docs::setValues)
        .def("setValues", SetValues(&Dialog::setValues))
        .def("addCallback", &Dialog::addCallback, Docs::addCallback)
        .def("removeCallback", &Dialog::removeCallback, Docs::removeCallback)
        .def("setWidgetResourceName", &Dialog::setWidgetResourceName, Docs::setWidgetResourceName)
        .def("displayWidget", &Dialog::displayWidget, Docs::displayWidget)
        .def("showWidget", &Dialog::showWidget, Docs::showWidget)
        .def("hideWidget", &Dialog::hideWidget, Docs::hideWidget)
        .def("isDisplayed", &Dialog::isDisplayed, Docs::isDisplayed)
        .def("enableWidget", &Dialog::enableWidget, Docs::enableWidget)
        .def("isEnabled", &Dialog::isEnabled, Docs::isEnabled)
        .def("disableNextClose", &Dialog::disableNextClose, Docs::disableNextClose);
}

void registerExceptions()
{
    UiError::initialize("ui", "UiError");
    bp::register_exception_translator<UiError>(&UiError::exceptionTranslator);
}

void moduleBody()
{
    bp::docstring_options const options(true, false, false);
    bp::handle<> const graphModule = importGraphModule();
    defineFunctions();
    registerEventType();
    registerDialog();
    bp::def("instantiateAppMgr", &instantiateAppMgr);
    registerExceptions();
    bp::scope().attr("__doc__") = Docs::module;
}

} // namespace

} // namespace Kv::PyextUi

BOOST_PYTHON_MODULE(libKVpyextUi)
{
    Kv::PyextUi::moduleBody();
}
