#pragma once

#include <boost/python/dict.hpp>
#include <boost/python/object.hpp>

#include "iterator.h"
#include "kvExport.h"
#include "piWidget.h"
#include "pointers/rcShdPtr.h"
#include "pointers/rcWeakPtr.h"
#include "pyWidgetCbs.h"
#include "uiAppMgr.h"
#include "uiContainer.h"
#include "uiTopLevel.h"

#include <map>
#include <string>
#include <tuple>
#include <vector>

namespace Kv::PyextUi
{

/// A push button whose name starts with this closes its dialog.
inline std::string const closeButtonPrefix = "CloseButton_";

/// A dialog: a window built from a description. A script fills, reads and hears of its widgets. It runs modally until
/// one of its close buttons is pressed. Inside the application it floats in the main panel, otherwise it has a window
/// of its own. Held through `RCShdPtr`; owns that window and every handler that it gives to the widgets in it.
///
/// A failure that the dialog finds itself is a `UiError`; those of the host pass through.
class KV_API Dialog : public RCBase<LkCounter<int>>
{
public:
    /// Places a dialog inside the application: its vertical centre lies on a boundary of equal bands of the main panel.
    struct Positionner
    {
        Positionner(int divisionCount, int boundary) : divisions(divisionCount), position(boundary) {}

        /// The number of bands; not zero.
        int divisions;
        /// The index of the boundary.
        int position;
    };

    /// Builds the dialog. Inside the application it is seen from here on, otherwise from `launch` on. `xmlString` is
    /// the description itself, `width` and `height` are the size of the content in pixels, where anything below 1
    /// stands for 80 % of the screen.
    Dialog(std::string const& title, std::string const& xmlString, int width, int height, Positionner const& position);
    Dialog(Dialog const&) = delete;
    Dialog& operator=(Dialog const&) = delete;
    ~Dialog() override;

    /// Shows the dialog and blocks until a close button ends it. Gives the button's name. An exception that a
    /// script's callback raises comes out of it.
    virtual std::string launch();

    /// Paints the window anew.
    virtual void redraw();

    /// Name of the close button pressed last; empty before the first.
    virtual std::string getCloseButtonClicked() const;

    /// The key under which `getValues` gives the close button.
    static std::string const& getCloseButtonClickedKey();

    /// Takes the dialog's widgets off the screen.
    void hide() const;

    /// Leaves the dialog open at the next press of a close button, only that.
    void disableNextClose();

    /// The value of the first widget of that name that has one; None if there is none, or it holds none.
    boost::python::object getValue(std::string const& widgetName) const;

    /// The values by widget name, and the close button pressed last if there is one.
    boost::python::dict getValues() const;

    /// Writes the first widget of that name that takes a value; without one nothing happens. With `invokeCallback` the
    /// callbacks of the change run. A value of the wrong form is Python's `TypeError` or `IndexError`, which passes as
    /// `error_already_set`.
    void setValue(std::string const& widgetName, boost::python::object const& value, bool invokeCallback);
    void setValue(std::string const& widgetName, boost::python::object const& value);

    /// Writes every widget that `values` names, in the order of the widgets. The entries of a menu are added to those
    /// that it has.
    void setValues(boost::python::dict const& values, bool invokeCallback);
    void setValues(boost::python::dict const& values);

    // The operations from here on throw `UiError` for a name that no widget has.

    /// The widget of that name, in whatever container it stands.
    RCShdPtr<UiWidget> getWidget(std::string const& name) const;

    /// Calls `cb` for events of that type on the widget from now on. `cb` is kept until it is removed.
    void addCallback(std::string const& widgetName, PiWidget::EventType eventType, PyObject* cb);

    /// Takes back the first `addCallback` with the same widget, type and object; without one nothing happens.
    void removeCallback(std::string const& widgetName, PiWidget::EventType eventType, PyObject* cb);

    /// Names the resource in which the widget's tooltip stands.
    void setWidgetResourceName(std::string const& widgetName, std::string const& resName);

    /// Shows or hides a widget; a hidden one keeps its value.
    void displayWidget(std::string const& widgetName, bool display) const;
    void showWidget(std::string const& widgetName) const;
    void hideWidget(std::string const& widgetName) const;
    bool isDisplayed(std::string const& widgetName) const;

    /// Enables or disables a widget; a disabled one keeps its value and takes no input.
    void enableWidget(std::string const& widgetName, bool enable) const;
    bool isEnabled(std::string const& widgetName) const;

    /// The callables of the scripts' callbacks, whose references the wrappers of the dialog share.
    KV_LOCAL PyCallables& getCallables();

protected:
    KV_LOCAL virtual boost::python::object getWidgetValue(RCShdPtr<UiContainer> container,
                                                          std::string const& widgetName) const;
    KV_LOCAL virtual void getWidgetValues(RCShdPtr<UiContainer> container, boost::python::dict& values) const;
    /// True once a widget has taken the value.
    KV_LOCAL virtual bool setWidgetValue(RCShdPtr<UiContainer> container, std::string const& widgetName,
                                         boost::python::object const& value, bool invokeCallback);
    KV_LOCAL virtual void setWidgetValues(RCShdPtr<UiContainer> container, boost::python::dict const& values,
                                          bool invokeCallback);

private:
    friend class WidgetCbs;

    using CallbackSets = std::vector<RCStrongPtr<CallbackSet>>;
    /// What `removeCallback` goes by.
    using CallbackKey = std::tuple<std::string, PiWidget::EventType, PyObject*>;
    using CallbacksByKey = std::multimap<CallbackKey, CallbackSet*>;

    KV_LOCAL void createUi(Positionner const& position);
    KV_LOCAL static RCShdPtr<UiContainer> createTopLevelPanel(RCShdPtr<UiTopLevel> const& topLevel);
    KV_LOCAL RCShdPtr<UiContainer> createFloatingContainer(int width, int height, int divisions, int position,
                                                           std::string const& title);
    KV_LOCAL void createTitleBar(RCShdPtr<UiContainer> const& container, std::string const& title);

    KV_LOCAL void onTitleBarMove(EvEvent& event);
    KV_LOCAL void onTitleBarPress(EvEvent& event);
    KV_LOCAL void onTitleBarRelease(EvEvent& event);

    /// The place of a script's callback; looked for from both ends, since one of the last or first goes as a rule.
    KV_LOCAL CallbackSets::iterator findCallback(CallbackSet const* set);

    /// Takes a script's callback from the widget, where that raises events, and from among the callbacks; its key goes
    /// if it has one.
    KV_LOCAL void takeBack(CallbackSets::iterator place, CallbacksByKey::iterator known,
                           RCShdPtr<PiWidget> const& piWidget);

    KV_LOCAL void clearCloseCallbacks();
    /// Takes the handler of a close button from the button that has it, where several bear the name.
    KV_LOCAL void unwireNamesake(CallbackSet const& set) const;
    KV_LOCAL void setupCloseCallbacks();

    KV_LOCAL static std::string const _closeButtonClickedKey;

    std::string _xml;
    std::string _title;
    int _width;
    int _height;
    bool _ownTopLevel = false;
    RCShdPtr<UiTopLevel> _topLevel;
    RCShdPtr<UiContainer> _container;
    UiEventCallback<Dialog> _moveCb;
    UiEventCallback<Dialog> _armCb;
    UiEventCallback<Dialog> _disarmCb;
    std::string _closeButtonClicked;
    RCShdPtr<WidgetCbs> _widgetCbs;
    CallbackSets _closeCallbacks;
    CallbackSets _callbacks;
    bool _closed;
    bool _disableNextClose = false;
    PyCallables _callables;
    /// The sets in `_callbacks`; those with one key in the order in which they came.
    CallbacksByKey _callbacksByKey;
};

} // namespace Kv::PyextUi

namespace Kv
{

// Users of dialogs share these with the module.
extern template class KV_API RCBasePtr<PyextUi::Dialog>;
extern template class KV_API Iterator<RCShdPtr<UiWidget>>;

} // namespace Kv
