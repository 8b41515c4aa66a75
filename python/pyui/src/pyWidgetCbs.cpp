#include <boost/python.hpp>

#include "pyWidgetCbs.h"

#include "pyCompat.h"
#include "pyDialog.h"
#include "pyManagedDialog.h"

namespace bp = boost::python;

namespace Kv::PyextUi
{

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
    bp::handle<> const name(
        PyCompat::stringFromStringAndSize(set->widgetName.data(), static_cast<Py_ssize_t>(set->widgetName.size())));
    bp::handle<> const eventType(bp::converter::registered<PiWidget::EventType>::converters.to_python(&set->eventType));
    bp::converter::void_result_from_python(
        PyObject_CallFunction(callable.get(), "(OOO)", pyDialog.get(), name.get(), eventType.get()));
}

} // namespace Kv::PyextUi
