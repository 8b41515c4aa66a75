#include <boost/python.hpp>

#include "pyConvenienceFunctions.h"

#include "brBrowserFloatingHandler.h"
#include "files/osFile.h"
#include "iterator.h"
#include "packages/inBuildInfo.h"
#include "piBrowserSchemes.h"
#include "pointers/plainPtr.h"
#include "pyUiError.h"
#include "pyUtils.h"
#include "pyWidgetListGenerator.h"
#include "uiAppMgr.h"
#include "uiApplication.h"
#include "uiConstraint.h"
#include "uiCursorGuard.h"
#include "wsCursorRegistry.h"

#include <algorithm>
#include <memory>
#include <stdexcept>

namespace bp = boost::python;

namespace Kv::PyextUi
{

namespace
{

std::string const cancelLabel = "Cancel";

// In pixels.
constexpr int rowHeight = 28;
constexpr int heightBase = 56;

// In layout units.
constexpr int closeButtonWidth = 14;
constexpr int closeButtonGap = 2;
constexpr int sideMargin = 2;

int heightFor(int rowCount)
{
    constexpr int maxRows = 1 << 18;
    return rowHeight * std::min(rowCount, maxRows) + heightBase;
}

/// The middle of the application's main panel.
Dialog::Positionner centre()
{
    return {2, 1};
}

RCShdPtr<Dialog> makeDialog(std::string const& title, std::string const& xmlString, int width, int height)
{
    return makeShd<Dialog>(title, xmlString, width, height, centre());
}

RCShdPtr<Dialog> makeDialog(std::string const& title, std::string const& xmlString, int width, int height,
                            bp::dict const& initialValues)
{
    RCShdPtr<Dialog> dialog = makeDialog(title, xmlString, width, height);
    dialog->setValues(initialValues, false);
    return dialog;
}

/// A line as it can be shown: each control character but tabs and line ends as the sign that Unicode has for it.
std::string toVisible(std::string const& line)
{
    constexpr unsigned char deleteCode = 0x7f;
    std::string visible;
    for (std::size_t i = 0; i < line.size(); ++i)
    {
        auto const code = static_cast<unsigned char>(line[i]);
        bool const endsLine = code == '\n' || (code == '\r' && (i + 1 == line.size() || line[i + 1] == '\n'));
        if ((code >= ' ' && code != deleteCode) || code == '\t' || endsLine)
            visible += line[i];
        else
            visible += {'\xe2', '\x90', static_cast<char>(0x80 + (code == deleteCode ? ' ' + 1 : code))};
    }
    return visible;
}

/// One run of the application's browser, for picking a path.
class PyBrowser
{
public:
    PyBrowser(std::string const& title, OsFilePath const& initialPath, bp::object const& pathValidationCb);

    /// OK was pressed.
    void onActivate(EvEvent&);

    BrBrowserFloatingHandler& getHandler() { return *_handler; }

    /// The path that was picked; empty if none was.
    OsFilePath const& getPath() const { return _path; }

private:
    void configure() const;
    OsFilePath validate(std::string const& focusPath, std::string const& currentPath) const;

    OPtr<BrBrowserFloatingHandler> _handler;
    RCShdPtr<BrBrowser> _browser;
    UiEventCallback<PyBrowser> _activateCb;
    bp::object _pathValidationCb;
    OsFilePath _path;
};

PyBrowser::PyBrowser(std::string const& title, OsFilePath const& initialPath, bp::object const& pathValidationCb)
    : _activateCb(this, &PyBrowser::onActivate), _pathValidationCb(pathValidationCb)
{
    Vector<LiString> const schemes{PiBrowserSchemes::FsScheme};
    UiAppMgr const& appMgr = UiAppMgr::getInstance();
    _handler = std::make_unique<BrBrowserFloatingHandler>(appMgr.getMainWindow()->getRootContainer(), title.c_str(),
                                                          appMgr.getSelection(), schemes, "", Bookmarkable(1));
    _browser = _handler->getBrowser();
    configure();
    if (OsFsUtils::fileExists(initialPath))
        static_cast<void>(_browser->setURL(initialPath.toString(), HistoryEnum(0), UpdateEnum(0)));
    _handler->setActivateCb(&_activateCb);
}

void PyBrowser::configure() const
{
    _browser->setFolderOption(PaneEnum(0));
    _browser->setViewType(BrTypes::ViewType(0));
    _browser->setSequencesCollapsed(true);
    _browser->setCompositionsCollapsed(false);
    _browser->setDontLoadCompositions(true);
}

void PyBrowser::onActivate(EvEvent&)
{
    std::string const focusPath = _browser->getInputFocusPath().toString();
    std::string const currentPath = _browser->getPath().toString();
    if (_pathValidationCb.is_none() || !PyCallable_Check(_pathValidationCb.ptr()))
        _path = OsFilePath(focusPath.empty() ? currentPath : focusPath);
    else
        _path = validate(focusPath, currentPath);
    if (!_path.isEmpty())
        _handler->hide();
}

OsFilePath PyBrowser::validate(std::string const& focusPath, std::string const& currentPath) const
{
    bp::object const focus{OsFilePath(focusPath)};
    bp::object const current{OsFilePath(currentPath)};
    bp::object const result(
        bp::handle<>(PyObject_CallFunction(_pathValidationCb.ptr(), "(OO)", focus.ptr(), current.ptr())));
    return bp::extract<OsFilePath>(result);
}

} // namespace

RCShdPtr<ManagedDialog> createDialog(std::string const& title, std::string const& xmlString, int width, int height,
                                     bp::dict const& initialValues)
{
    return makeManaged(makeDialog(title, xmlString, width, height, initialValues));
}

bp::dict showDialog(std::string const& title, std::string const& xmlFile, int width, int height,
                    bp::dict const& initialValues)
{
    std::string const xmlString = readDescriptionFile(OsFilePath(xmlFile));
    RCShdPtr<Dialog> const dialog = makeDialog(title, xmlString, width, height, initialValues);
    dialog->launch();
    return dialog->getValues();
}

bp::dict showSimpleDialog(std::string const& title, bp::list const& widgets, int width, bool cancelButton,
                          bp::dict const& initialValues)
{
    int const height = heightFor(lengthOf(widgets));
    bp::list closeButtons;
    closeButtons.append(okLabel);
    if (cancelButton)
        closeButtons.append(cancelLabel);
    std::string const xmlString = WidgetListGenerator(widgets, closeButtons).generate();
    RCShdPtr<Dialog> const dialog = withNote([&] { return makeDialog(title, xmlString, width, height); },
                                             [&] { return WidgetListGenerator::describeUnknownKind(widgets); });
    dialog->setValues(initialValues, false);
    dialog->launch();
    return dialog->getValues();
}

std::string showMessageBox(std::string const& title, bp::list const& messages, bp::list const& closeButtons)
{
    int const lineCount = lengthOf(messages);
    int const buttonCount = std::clamp(lengthOf(closeButtons), 1, 1 << 18);
    int const height = heightFor(lineCount);
    int contentWidth = closeButtonWidth * buttonCount - closeButtonGap;
    bp::list widgets;
    forEachEntry(messages, lineCount, "list of messages",
                 [&](int i)
                 {
                     std::string const line = toVisible(bp::extract<std::string>(messages[i]));
                     contentWidth = std::max(contentWidth, measureInUnits(line));
                     widgets.append(bp::make_tuple("Label", "Msg", "", line));
                 });
    contentWidth += sideMargin;
    int const width = static_cast<int>(static_cast<float>(contentWidth) * UiConstraint::getUIGrid().x);
    std::string const xmlString = WidgetListGenerator(widgets, closeButtons).generate();
    RCShdPtr<Dialog> const dialog = makeDialog(title, xmlString, width, height);
    std::string const closeButton = dialog->launch();
    // An `IndexError` to a script.
    if (closeButton.size() < closeButtonPrefix.size())
        throw std::out_of_range("The message box was ended without one of its buttons");
    return closeButton.substr(closeButtonPrefix.size());
}

std::string makeXmlFromWidgetList(bp::list const& widgets, bp::list const& closeButtons)
{
    return WidgetListGenerator(widgets, closeButtons).generate();
}

OsFilePath showBrowser(std::string const& title, OsFilePath const& initialPath, bp::object const& pathValidationCb)
{
    if (InBuildInfoUtil::getApplicationMode() == ApplicationModes(1))
        throw UiError(__FILE__, __LINE__, "ui.showBrowser() can only be used within Velmora.");
    PyBrowser browser(title, initialPath, pathValidationCb);
    BrBrowserFloatingHandler& handler = browser.getHandler();
    UiAppDisabler const disabler;
    RCShdPtr<UiMoveContainer> const container = handler.getContainer();
    container->getParent()->front(container);
    handler.show();
    {
        UiCursorGuard const cursor(WsCursorRegistry::Normal);
        UiApplication::getInstance()->localMessageLoop(handler.isClosedConst(), handler.isClosed());
    }
    return browser.getPath();
}

} // namespace Kv::PyextUi
