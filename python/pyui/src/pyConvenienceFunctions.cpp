#include <boost/python.hpp>

#include "pyConvenienceFunctions.h"

#include "pyUtils.h"
#include "pyWidgetListGenerator.h"
#include "ui/uiConstraint.h"

#include <algorithm>

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
    RCShdPtr<Dialog> const dialog = makeDialog(title, xmlString, width, height, initialValues);
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
    for (int i = 0; i < lineCount; ++i)
    {
        std::string const line = bp::extract<std::string>(messages[i]);
        contentWidth = std::max(contentWidth, measureInUnits(line));
        widgets.append(bp::make_tuple("Label", "Msg", "", line));
    }
    contentWidth += sideMargin;
    int const width = static_cast<int>(static_cast<float>(contentWidth) * UiConstraint::getUIGrid().x);
    std::string const xmlString = WidgetListGenerator(widgets, closeButtons).generate();
    RCShdPtr<Dialog> const dialog = makeDialog(title, xmlString, width, height);
    return dialog->launch().substr(closeButtonPrefix.size());
}

std::string makeXmlFromWidgetList(bp::list const& widgets, bp::list const& closeButtons)
{
    return WidgetListGenerator(widgets, closeButtons).generate();
}

} // namespace Kv::PyextUi
