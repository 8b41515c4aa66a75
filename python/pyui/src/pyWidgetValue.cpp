#include <boost/python.hpp>

#include "pyWidgetValue.h"

#include "pyUiError.h"
#include "pyUtils.h"
#include "uiContainer.h"
#include "uiDualState.h"
#include "uiMenu.h"
#include "uiTextField.h"

#include <map>
#include <typeinfo>
#include <utility>
#include <vector>

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
    auto const form = castTo<bp::tuple>(value);
    auto const entries = castTo<bp::list>(form[0]);
    int const count = lengthOf(entries);
    if (mode == MenuEntries::Replace)
        menu.removeAll();
    for (int i = 0; i < count; ++i)
        menu.append(bp::extract<std::string>(entries[i])().c_str());
    return bp::extract<int>(form[1]);
}

ValueKind castToKind(UiWidget const& widget)
{
    if (dynamic_cast<UiContainer const*>(&widget))
        return ValueKind::Container;
    if (dynamic_cast<UiTextField const*>(&widget))
        return ValueKind::TextField;
    if (dynamic_cast<UiDualState const*>(&widget))
        return ValueKind::ToggleButton;
    return dynamic_cast<UiMenu const*>(&widget) ? ValueKind::Menu : ValueKind::None;
}

} // namespace

ValueKind findValueKind(UiWidget const& widget)
{
    // Few classes, each looked into once: a cast compares names.
    static std::vector<std::pair<std::type_info const*, ValueKind>> known;
    std::type_info const* const type = &typeid(widget);
    for (auto const& [knownType, kind] : known)
        if (knownType == type)
            return kind;
    known.emplace_back(type, castToKind(widget));
    return known.back().second;
}

bp::object readValue(UiWidget const& widget, ValueKind kind)
{
    switch (kind)
    {
    case ValueKind::TextField:
        return bp::object(static_cast<UiTextField const&>(widget).getString());
    case ValueKind::ToggleButton:
        return bp::object(static_cast<UiDualState const&>(widget).getState());
    case ValueKind::Menu:
        return bp::object(static_cast<UiMenu const&>(widget).getStrPtr());
    default:
        return bp::object();
    }
}

void writeValue(UiWidget& widget, ValueKind kind, bp::object const& value, MenuEntries mode, bool invokeCallback)
{
    auto const read = [&](auto action, char const* name)
    { return withNote(action, [&] { return describeValue(name, widget.getName(), value); }); };
    switch (kind)
    {
    case ValueKind::TextField:
        static_cast<UiTextField&>(widget).setString(read([&] { return readText(value); }, "TextField"),
                                                    UiTextField::End, false, invokeCallback);
        break;
    case ValueKind::ToggleButton:
        static_cast<UiDualState&>(widget).setState(read([&] { return bp::extract<bool>(value)(); }, "ToggleButton"),
                                                   invokeCallback);
        break;
    case ValueKind::Menu:
    {
        auto& menu = static_cast<UiMenu&>(widget);
        menu.setSelection(read([&] { return fillMenu(menu, value, mode); }, "Menu"), invokeCallback);
        break;
    }
    default:
        break;
    }
}

bp::object describeValue(std::string const& kind, std::string const& widgetName, bp::object const& value)
{
    return bp::str(forms.at(kind)) % bp::make_tuple(widgetName) + "; it was given " + toShortText(value);
}

} // namespace Kv::PyextUi
