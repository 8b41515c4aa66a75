#include <boost/python.hpp>

#include "packages/inBuildInfo.h"
#include "packages/inInit.h"
#include "piBrowserSchemes.h"
#include "pyConvenienceFunctions.h"
#include "pyManagedDialog.h"
#include "pyModule.h"
#include "pyUiError.h"
#include "pyWorkspace.h"
#include "pyextUiDocs.h"
#include "uiAppMgr.h"
#include "uiCursorGuard.h"

#include <memory>
#include <string>
#include <vector>

namespace bp = boost::python;

namespace Kv
{

namespace
{

class LibraryBuildInfo : public InBuildInfo
{
public:
    char const* getProductName() const override { return "Quorvane Velmora Library"; }
    char const* getLibraryName() const override { return "libKvpyextUi"; }
    char const* getReleaseYear() const override { return "2013"; }
    char const* getVersionString() const override { return "8.0"; }
    char const* getVersionSuffix() const override { return getReleaseStage() == 3 ? "dev" : ""; }
    int getMajorVersion() const override { return 8; }
    int getMinorVersion() const override { return 0; }
    int getReleaseStage() const override { return 42; }
    char const* getBuildNumber() const override { return "2600"; }
    char const* getBuildDate() const override { return __DATE__; }
    char const* getBuildFlavour() const override { return KV_BUILD_FLAVOUR; }
};

} // namespace

KV_PACKAGE(pyextUi, pyextGraph, pyextInit, appUi, gfx, ui, internalAPI, framework, scriptingAPI, resmgt, pluginAPI,
           base)

template <> void InInit<KvInit::pyextUi>::initPackage()
{
    InBuildInfoUtil::registerInfo(std::make_unique<LibraryBuildInfo>());
}

} // namespace Kv

namespace Kv::PyextUi
{

namespace
{

/// The place of a parameter without a name in a keyword list, which must have one for every parameter. Boost.Python
/// binds the list to the last parameters of an overload and takes its last name away for each overload that has a
/// parameter less. A shorter list ends the process when a script passes another parameter by name.
bp::arg positional()
{
    return bp::arg("");
}

BOOST_PYTHON_FUNCTION_OVERLOADS(createDialogOverloads, createDialog, 2, 5)
BOOST_PYTHON_FUNCTION_OVERLOADS(showDialogOverloads, showDialog, 2, 5)
BOOST_PYTHON_FUNCTION_OVERLOADS(showSimpleDialogOverloads, showSimpleDialog, 3, 5)
BOOST_PYTHON_FUNCTION_OVERLOADS(showMessageBoxOverloads, showMessageBox, 2, 3)
BOOST_PYTHON_FUNCTION_OVERLOADS(makeXmlOverloads, makeXmlFromWidgetList, 1, 2)
BOOST_PYTHON_FUNCTION_OVERLOADS(showBrowserOverloads, showBrowser, 1, 3)

void instantiateAppMgr()
{
    UiAppMgr::getInstance();
}

/// Imports the module that has the converters for graphs.
bp::handle<> importGraphModule()
{
    std::string const name = "libKVpyextGraph";
    std::string const fullName = "quorvane_velmora.libs." + name;
    auto const import = [](std::string const& moduleName)
    { return PyImport_ImportModuleLevel(moduleName.c_str(), nullptr, nullptr, nullptr, 0); };
    bp::handle<> const module(bp::allow_null(import(fullName)));
    if (module)
        return module;
    PyErr_Clear();
    return bp::handle<>(import(name));
}

template <typename Overloads, typename Function, std::size_t count>
void defineFunction(char const* name, Function function, bp::detail::keywords<count> const& parameters, char const* doc)
{
    bp::def(name, function, Overloads(parameters, doc));
    std::vector<std::string> names;
    for (bp::detail::keyword const& parameter : parameters.elements)
        names.emplace_back(parameter.name);
    explainArguments(bp::scope().attr(name), names);
}

void defineFunctions()
{
    using bp::arg;
    defineFunction<showDialogOverloads>("showDialog", &showDialog,
                                        (positional(), positional(), arg("width"), arg("height"), arg("initialValues")),
                                        Docs::showDialog);
    defineFunction<showSimpleDialogOverloads>(
        "showSimpleDialog", &showSimpleDialog,
        (positional(), positional(), positional(), arg("cancelButton"), arg("initialValues")), Docs::showSimpleDialog);
    defineFunction<showMessageBoxOverloads>("showMessageBox", &showMessageBox,
                                            (positional(), positional(), arg("closeButtons")), Docs::showMessageBox);
    defineFunction<makeXmlOverloads>("makeXmlFromWidgetList", &makeXmlFromWidgetList,
                                     (positional(), arg("closeButtons")), Docs::makeXmlFromWidgetList);
    defineFunction<createDialogOverloads>(
        "createDialog", &createDialog, (positional(), positional(), arg("width"), arg("height"), arg("initialValues")),
        Docs::createDialog);
    defineFunction<showBrowserOverloads>(
        "showBrowser", &showBrowser, (arg("title"), arg("initialPath"), arg("pathValidationCb")), Docs::showBrowser);
}

void registerEventType()
{
    if (PyextInit::shareClass<PiWidget::EventType>("EventType"))
        return;
    bp::enum_<PiWidget::EventType> eventType("EventType");
    eventType.value("ENABLE", PiWidget::Enable)
        .value("DISABLE", PiWidget::Disable)
        .value("STATE", PiWidget::State)
        .value("ACTIVATE", PiWidget::Activate)
        .value("VALUE_CHANGED", PiWidget::ValueChanged);
    eventType.attr("__doc__") = Docs::eventType;
}

void registerDialog()
{
    using SetValue = void (Dialog::*)(std::string const&, bp::object const&);
    using SetValueNotifying = void (Dialog::*)(std::string const&, bp::object const&, bool);
    using SetValues = void (Dialog::*)(bp::dict const&);
    using SetValuesNotifying = void (Dialog::*)(bp::dict const&, bool);
    if (PyextInit::shareClass<Dialog>("Dialog"))
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
    explainMethods(dialog);
}

void registerCursorGuard()
{
    if (PyextInit::shareClass<UiCursorGuard>("CursorGuard"))
        return;
    bp::class_<UiCursorGuard, boost::noncopyable>("CursorGuard", Docs::cursorGuard,
                                                  bp::init<std::string>(Docs::cursorGuardInit));
}

void registerBrowserScheme()
{
    if (PyextInit::shareClass<PiBrowserSchemes>("BrowserScheme"))
        return;
    bp::class_<PiBrowserSchemes> scheme("BrowserScheme", Docs::browserScheme, bp::no_init);
    scheme.attr("FILE_SYSTEM") = PiBrowserSchemes::FsScheme.toString();
    scheme.attr("GANTRY") = PiBrowserSchemes::GantryScheme.toString();
    scheme.attr("TOOLS") = PiBrowserSchemes::PluginToolScheme.toString();
    scheme.attr("VIEWS") = PiBrowserSchemes::PluginViewScheme.toString();
    scheme.attr("PICK_LIST") = PiBrowserSchemes::PicklistScheme.toString();
    scheme.attr("BOOKMARKS") = PiBrowserSchemes::BookmarkScheme.toString();
}

void registerWorkspace()
{
    if (PyextInit::shareClass<Workspace>("Workspace"))
        return;
    bp::class_<Workspace, boost::noncopyable>("Workspace", Docs::workspace, bp::init<>())
        .def("getCurrentComposition", &Workspace::getCurrentComposition, Docs::getCurrentComposition)
        .staticmethod("getCurrentComposition")
        .def("getCompositions", &Workspace::getCompositions, Docs::getCompositions)
        .staticmethod("getCompositions")
        .def("getNbCompositions", &Workspace::getNbCompositions, Docs::getNbCompositions)
        .staticmethod("getNbCompositions")
        .def("openComposition", &Workspace::openComposition, Docs::openComposition)
        .staticmethod("openComposition")
        .def("isCompositionOpened", &Workspace::isCompositionOpened, Docs::isCompositionOpened)
        .staticmethod("isCompositionOpened")
        .def("getBrowserSelection", &Workspace::getBrowserSelection, Docs::getBrowserSelection)
        .staticmethod("getBrowserSelection");
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
    registerCursorGuard();
    registerBrowserScheme();
    registerWorkspace();
    bp::def("instantiateAppMgr", &instantiateAppMgr);
    registerExceptions();
    bp::scope().attr("__doc__") = Docs::module;
}

} // namespace

} // namespace Kv::PyextUi

extern "C" KV_API PyObject* PyInit_libKVpyextUi()
{
    return Kv::PyextInit::initModule<&Kv::PyextUi::moduleBody>("libKVpyextUi");
}
