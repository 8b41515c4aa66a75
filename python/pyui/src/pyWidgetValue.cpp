#include <boost/python.hpp>

#include "pyWidgetValue.h"

#include "pyUiError.h"
#include "pyUtils.h"
#include "uiDualState.h"
#include "uiMenu.h"
#include "uiTextField.h"

#include <map>

namespace bp = boost::python;

namespace Kv::PyextUi
{

namespace
{

std::map<std::string, char const*> const forms{
    {"TextField", "The text field %r takes a str or None"},
    {"ToggleButton", "The toggle button %r takes a bool, an int or None"},
    {"Menu", "The menu %r takes a tuple of a list of str and an index, as (['a', 'b'], 0)"},
    {"Label", "The label %r takes a str or None"},
};

/// A text, or null for None. Boost.Python hides the error of a text that has no UTF-8 behind one about its type.
char const* readText(bp::object const& value)
{
    bp::extract<char const*> text(value);
    if (!text.check() && PyErr_Occurred())
        bp::throw_error_already_set();
    return text();
}

/// Gives the index that the value selects.
int fillMenu(UiMenu& menu, bp::object const& value, MenuEntries mode)
{
    bp::tuple const form = bp::extract<bp::tuple>(value);
    bp::list const entries = bp::extract<bp::list>(form[0]);
    int const count = lengthOf(entries);
    if (mode == MenuEntries::Replace)
        menu.removeAll();
    for (int i = 0; i < count; ++i)
        menu.append(bp::extract<std::string>(entries[i])().c_str());
    return bp::extract<int>(form[1]);
}

} // namespace

bool hasValue(RCShdPtr<UiWidget> const& widget)
{
    return dynamicCast<UiTextField>(widget) || dynamicCast<UiDualState>(widget) || dynamicCast<UiMenu>(widget);
}

bp::object readValue(RCShdPtr<UiWidget> const& widget)
{
    if (RCShdPtr<UiTextField> const field = dynamicCast<UiTextField>(widget))
        return bp::object(field->getString());
    if (RCShdPtr<UiDualState> const toggle = dynamicCast<UiDualState>(widget))
        return bp::object(toggle->getState());
    return bp::object(dynamicCast<UiMenu>(widget)->getStrPtr());
}

void writeValue(RCShdPtr<UiWidget> const& widget, bp::object const& value, MenuEntries mode, bool invokeCallback)
{
    auto const read = [&](auto action, char const* kind)
    { return withNote(action, [&] { return describeValue(kind, widget->getName(), value); }); };
    if (RCShdPtr<UiTextField> const field = dynamicCast<UiTextField>(widget))
        field->setString(read([&] { return readText(value); }, "TextField"), UiTextField::End, false, invokeCallback);
    else if (RCShdPtr<UiDualState> const toggle = dynamicCast<UiDualState>(widget))
        toggle->setState(read([&] { return bp::extract<bool>(value)(); }, "ToggleButton"), invokeCallback);
    else
    {
        RCShdPtr<UiMenu> const menu = dynamicCast<UiMenu>(widget);
        menu->setSelection(read([&] { return fillMenu(*menu, value, mode); }, "Menu"), invokeCallback);
    }
}

bp::object describeValue(std::string const& kind, std::string const& widgetName, bp::object const& value)
{
    return bp::str(forms.at(kind)) % bp::make_tuple(widgetName) + "; it was given " + toShortText(value);
}

} // namespace Kv::PyextUi
