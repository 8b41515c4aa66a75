#pragma once

#include "geometry.h"
#include "kvExport.h"
#include "ntWindow.h"
#include "pointers/rcBase.h"
#include "pointers/rcShdPtr.h"

#include <memory>

namespace Kv
{

/// The edges and buttons that the window manager puts around a window. One style of each is all that windows have here.
enum class BorderStyle
{
    Resizable = 0,
};

enum class TitleBarStyle
{
    Shown = 0,
};

enum class TaskBarStyle
{
    Shown = 0,
};

enum class StackingStyle
{
    Normal = 0,
};

enum class CloseButtonStyle
{
    None = 1,
};

/// The look of a window on the screen, and its place.
class KV_API WsWindowStyle : public RCBase<LkCounter<int>>
{
public:
    explicit WsWindowStyle(GeRectangle<int> const& frame) : _frame(frame) {}

    /// The place of the window's content, in pixels of the screen, y growing upward.
    GeRectangle<int> const& getFrame() const { return _frame; }

private:
    GeRectangle<int> _frame;
};

/// Makes window styles.
class KV_API WsWindowStyleUtils
{
public:
    /// The style of a window for `frame`, on the screen of the number `screen`; 0 is the one that there always is.
    static RCShdPtr<WsWindowStyle> getNormalWindowStyle(GeRectangle<int> const& frame, int screen, BorderStyle border,
                                                        TitleBarStyle titleBar, TaskBarStyle taskBar,
                                                        StackingStyle stacking, CloseButtonStyle closeButton);
};

/// A window of the window system; owns its native side.
class KV_API WsWindow : public RCBase<LkCounter<int>>
{
public:
    explicit WsWindow(std::unique_ptr<NtWindow> native);
    ~WsWindow() override;

    NtWindow& getNative() { return *_native; }

    /// Drops the input that is still queued for the window.
    void flushAllEvents();

private:
    std::unique_ptr<NtWindow> _native;
};

} // namespace Kv
