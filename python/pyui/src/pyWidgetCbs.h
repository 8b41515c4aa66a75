#pragma once

#include <Python.h>

#include <boost/python/handle.hpp>

#include "cbHandler.h"
#include "piWidget.h"
#include "pointers/rcBase.h"
#include "pointers/rcShdPtr.h"
#include "pointers/rcWeakPtr.h"

#include <string>
#include <vector>

namespace Kv
{

/// One wired callback: of a close button, or of a script. It and its handler hold each other until `release`, so that
/// both outlive a dispatch in which they are taken out.
struct CallbackSet
{
    std::string widgetName;
    PiWidget::EventType eventType;
    /// The script's callable, borrowed; null for a close button.
    PyObject* callable;
    /// Null for a script's callback on a widget that raises no events.
    RCStrongPtr<CbHandler<EvEvent>> handler;
};

} // namespace Kv

namespace Kv::PyextUi
{

class Dialog;

/// The callables of a dialog's script callbacks. They are kept in a Python dictionary, so that Python's garbage
/// collector can follow a callable that refers to its own dialog. Each Python object that shares the dialog has one
/// reference to the dictionary and reports it to the collector. Without such an object, the dialog has the only one.
class PyCallables
{
public:
    PyCallables();
    PyCallables(PyCallables const&) = delete;
    PyCallables& operator=(PyCallables const&) = delete;
    ~PyCallables();

    void add(CallbackSet const& set);
    void remove(CallbackSet const& set);

    /// The callable of a set; null once it was removed, or taken by the collector.
    boost::python::handle<> find(CallbackSet const& set) const;

    /// One more Python object shares the dialog, or one less.
    void addShare();
    void releaseShare();
    int getShareCount() const { return _shares; }

    /// Borrowed, for the collector.
    PyObject* getDictionary() const { return _dictionary; }

private:
    PyObject* _dictionary;
    int _shares = 0;
};

/// The hub that the handlers of a dialog are bound to. It turns events into the close of the dialog and into calls of
/// Python.
class WidgetCbs : public RCBase<LkCounter<int>>
{
public:
    /// `dialog` is borrowed: it owns the hub.
    explicit WidgetCbs(Dialog* dialog) : _dialog(dialog) {}

    /// Wires a set of a close button to the button's events.
    void addCloseHandler(RCShdPtr<PiWidget> const& piWidget, RCStrongPtr<CallbackSet> const& set);

    /// Wires a set of a script to a widget's events.
    void addPythonHandler(RCShdPtr<PiWidget> const& piWidget, RCStrongPtr<CallbackSet> const& set);

    /// Lets a set and its handler go of each other. A dispatch under way goes on with both.
    static void release(RCStrongPtr<CallbackSet> const& set);

    /// Releases each set, first to last, and empties the vector.
    static void releaseAll(std::vector<RCStrongPtr<CallbackSet>>& sets);

private:
    using Handler = CbDataMethod<WidgetCbs, EvEvent, RCStrongPtr<CallbackSet>>;

    void addHandler(RCShdPtr<PiWidget> const& piWidget, RCStrongPtr<CallbackSet> const& set, Handler::Method method);

    void onCloseButton(EvEvent& event, RCStrongPtr<CallbackSet> set);
    void onEvent(EvEvent& event, RCStrongPtr<CallbackSet> set);

    Dialog* _dialog;
};

} // namespace Kv::PyextUi
