#pragma once

#include "evPointerEvent.h"
#include "ntPeer.h"

namespace Kv
{

class UiWidget;

/// Takes what the pointer does on a widget to the handlers, which it borrows.
class UiPointerCallbacks : public NtPointerListener
{
public:
    /// `widget` is borrowed: it owns these.
    explicit UiPointerCallbacks(UiWidget* widget) : _widget(widget) {}

    void setMoveCb(CbHandler<EvEvent>* handler) { _moveCb = handler; }
    void setDownCb(CbHandler<EvEvent>* handler) { _downCb = handler; }
    void setUpCb(CbHandler<EvEvent>* handler) { _upCb = handler; }

    /// Forgets the handlers.
    void clear();

    void onPointerMoved(int x, int y, bool isButtonDown) override;
    void onPointerDown(int x, int y) override;
    void onPointerUp(int x, int y) override;

private:
    template <typename Event, typename... Args>
    void run(CbHandler<EvEvent>* handler, int x, int y, Args const&... args) const;

    UiWidget* _widget;
    CbHandler<EvEvent>* _moveCb = nullptr;
    CbHandler<EvEvent>* _downCb = nullptr;
    CbHandler<EvEvent>* _upCb = nullptr;
};

} // namespace Kv
