#pragma once

#include "geometry.h"
#include "kvExport.h"
#include "piWidget.h"
#include "pointers/rcShdPtr.h"
#include "uiMoveContainer.h"

namespace Kv
{

/// Owns a floating container with a title bar that the user moves it by. It goes with the handler.
class KV_API UiFloatingHandler
{
public:
    UiFloatingHandler(UiFloatingHandler const&) = delete;
    UiFloatingHandler& operator=(UiFloatingHandler const&) = delete;
    virtual ~UiFloatingHandler();

    RCShdPtr<UiMoveContainer> const& getContainer() const;

    virtual void show();
    virtual void hide();

protected:
    /// In pixels.
    static constexpr int titleHeight = 24;

    /// A hidden container in the middle of `parent`, of `size` pixels with the title bar, and smaller where the parent
    /// is smaller.
    UiFloatingHandler(RCShdPtr<UiContainer> const& parent, char const* name, char const* title,
                      GeVector2<int> const& size);

private:
    void createTitleBar(char const* title);
    void onPointerMoved(EvEvent& event);
    void onPointerDown(EvEvent& event);
    void onPointerUp(EvEvent& event);

    UiEventCallback<UiFloatingHandler> _moveCb;
    UiEventCallback<UiFloatingHandler> _armCb;
    UiEventCallback<UiFloatingHandler> _disarmCb;
    RCShdPtr<UiMoveContainer> _container;
};

} // namespace Kv
