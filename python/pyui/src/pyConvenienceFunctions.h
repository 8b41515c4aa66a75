#pragma once

#include <boost/python/dict.hpp>
#include <boost/python/list.hpp>
#include <boost/python/object.hpp>

#include "files/osFilePath.h"
#include "pointers/rcShdPtr.h"
#include "pyManagedDialog.h"

#include <string>

namespace Kv::PyextUi
{

// The module's functions. Sizes are in pixels, where anything below 1 stands for 80 % of the screen; initial values are
// written without running callbacks. Failures are those of `Dialog` and of the description.

/// A dialog that has not been launched, from the description `xmlString`.
RCShdPtr<ManagedDialog> createDialog(std::string const& title, std::string const& xmlString, int width = -1,
                                     int height = -1, boost::python::dict const& initialValues = boost::python::dict());

/// Shows a dialog from the description in the file `xmlFile` and gives its values when it closes. Throws `UiError` for
/// a file that cannot be opened.
boost::python::dict showDialog(std::string const& title, std::string const& xmlFile, int width = -1, int height = -1,
                               boost::python::dict const& initialValues = boost::python::dict());

/// Shows a form made from widget entries and gives its values when it closes.
boost::python::dict showSimpleDialog(std::string const& title, boost::python::list const& widgets, int width,
                                     bool cancelButton = false,
                                     boost::python::dict const& initialValues = boost::python::dict());

/// Shows lines of text and gives the label of the button that closed them.
std::string showMessageBox(std::string const& title, boost::python::list const& messages,
                           boost::python::list const& closeButtons = boost::python::list());

/// The description of a form made from widget entries.
std::string makeXmlFromWidgetList(boost::python::list const& widgets,
                                  boost::python::list const& closeButtons = boost::python::list());

/// Lets the user pick a path in the application's file browser, which begins at `initialPath` if that exists. On OK it
/// calls `pathValidationCb` with the path in focus, empty if there is none, and the current directory. The callback
/// gives the path, or the empty one to keep the browser open. Without a callback that can be called, the path is the
/// one in focus, else the directory. Gives the empty path on Cancel. Throws `UiError` outside the application.
OsFilePath showBrowser(std::string const& title, OsFilePath const& initialPath = OsFilePath(),
                       boost::python::object const& pathValidationCb = boost::python::object());

} // namespace Kv::PyextUi
