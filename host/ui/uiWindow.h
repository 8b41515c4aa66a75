#pragma once

#include "kvExport.h"
#include "pointers/rcShdPtr.h"
#include "wsWindow.h"

namespace Kv
{

class UiContainer;

/// A tree of widgets on the screen.
class KV_API UiWindow
{
public:
    virtual ~UiWindow() = default;

    /// The container of all widgets of the window.
    virtual RCShdPtr<UiContainer> getRootContainer() const = 0;

    /// The window of the window system; null before the first show.
    virtual RCShdPtr<WsWindow> getOSWindow() const = 0;

    virtual bool isShown() const = 0;

    /// The number of refusals of input in the window that are in force.
    virtual int getInputLevel() const { return 0; }

    /// Paints the window anew. True if it stands on the screen.
    virtual bool redraw() = 0;
};

} // namespace Kv
