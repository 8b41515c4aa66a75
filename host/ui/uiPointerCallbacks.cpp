#include "uiPointerCallbacks.h"

#include "uiWidget.h"

namespace Kv
{

void UiPointerCallbacks::clear()
{
    _moveCb = nullptr;
    _downCb = nullptr;
    _upCb = nullptr;
}

void UiPointerCallbacks::onPointerMoved(int x, int y, bool isButtonDown)
{
    run<EvPointerMoveEvent>(_moveCb, x, y, isButtonDown);
}

void UiPointerCallbacks::onPointerDown(int x, int y)
{
    run<EvPointerButtonDownEvent>(_downCb, x, y);
}

void UiPointerCallbacks::onPointerUp(int x, int y)
{
    run<EvPointerButtonUpEvent>(_upCb, x, y);
}

template <typename Event, typename... Args>
void UiPointerCallbacks::run(CbHandler<EvEvent>* handler, int x, int y, Args const&... args) const
{
    if (!handler || !_widget->takesInput())
        return;
    // The handler may end the widget, and with it these.
    RCShdPtr<UiWidget> const keeper(_widget);
    Event event(_widget->flipY(x, y), args...);
    handler->call(event);
}

} // namespace Kv
