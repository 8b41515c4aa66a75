#include <boost/python.hpp>

#include "pyWidgetCbs.h"

#include "pyDialog.h"
#include "pyManagedDialog.h"

namespace bp = boost::python;

namespace Kv::PyextUi
{

namespace
{

bp::handle<> keyOf(CallbackSet const& set)
{
    return bp::handle<>(PyLong_FromVoidPtr(const_cast<CallbackSet*>(&set)));
}

} // namespace

PyCallables::PyCallables() : _dictionary(bp::handle<>(PyDict_New()).release()) {}

PyCallables::~PyCallables()
{
    Py_DECREF(_dictionary);
}

void PyCallables::add(CallbackSet const& set)
{
    if (PyDict_SetItem(_dictionary, keyOf(set).get(), set.callable) != 0)
        bp::throw_error_already_set();
}

void PyCallables::remove(CallbackSet const& set)
{
    if (find(set) && PyDict_DelItem(_dictionary, keyOf(set).get()) != 0)
        bp::throw_error_already_set();
}

bp::handle<> PyCallables::find(CallbackSet const& set) const
{
    // The plain call drops every error, also that of a recursion which is too deep.
    PyObject* const callable = PyDict_GetItemWithError(_dictionary, keyOf(set).get());
    if (!callable && PyErr_Occurred())
        bp::throw_error_already_set();
    return bp::handle<>(bp::borrowed(bp::allow_null(callable)));
}

void PyCallables::addShare()
{
    if (_shares++ > 0)
        Py_INCREF(_dictionary);
}

void PyCallables::releaseShare()
{
    if (--_shares > 0)
        Py_DECREF(_dictionary);
}

void WidgetCbs::addCloseHandler(RCShdPtr<PiWidget> const& piWidget, RCStrongPtr<CallbackSet> const& set)
{
    addHandler(piWidget, set, &WidgetCbs::onCloseButton);
}

void WidgetCbs::addPythonHandler(RCShdPtr<PiWidget> const& piWidget, RCStrongPtr<CallbackSet> const& set)
{
    addHandler(piWidget, set, &WidgetCbs::onEvent);
}

void WidgetCbs::addHandler(RCShdPtr<PiWidget> const& piWidget, RCStrongPtr<CallbackSet> const& set,
                           Handler::Method method)
{
    set->handler = makeStrong<Handler>(this, method, set);
    piWidget->addCallback(set->eventType, set->handler.get());
}

void WidgetCbs::release(RCStrongPtr<CallbackSet> const& set)
{
    if (auto* const handler = static_cast<Handler*>(set->handler.get()))
        handler->releaseData();
}

void WidgetCbs::releaseAll(std::vector<RCStrongPtr<CallbackSet>>& sets)
{
    for (RCStrongPtr<CallbackSet>& set : sets)
    {
        release(set);
        set = RCStrongPtr<CallbackSet>();
    }
    sets.clear();
}

void WidgetCbs::onCloseButton(EvEvent&, RCStrongPtr<CallbackSet> set)
{
    _dialog->_closeButtonClicked = set->widgetName;
    if (!_dialog->_disableNextClose)
        _dialog->_closed = true;
    _dialog->_disableNextClose = false;
}

void WidgetCbs::onEvent(EvEvent&, RCStrongPtr<CallbackSet> set)
{
    RCShdPtr<Dialog> const dialog(_dialog);
    bp::handle<> const callable = dialog->_callables.find(*set);
    if (!callable)
        return;
    RCShdPtr<ManagedDialog> const managed = makeManaged(dialog);
    bp::handle<> const pyDialog(bp::converter::registered<RCShdPtr<ManagedDialog>>::converters.to_python(&managed));
    bp::object const name(set->widgetName);
    bp::handle<> const eventType(bp::converter::registered<PiWidget::EventType>::converters.to_python(&set->eventType));
    bp::converter::void_result_from_python(
        PyObject_CallFunction(callable.get(), "(OOO)", pyDialog.get(), name.ptr(), eventType.get()));
}

} // namespace Kv::PyextUi
