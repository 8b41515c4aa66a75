#pragma once

#include "ntContainer.h"

namespace Kv
{

/// Hears of the user of a window.
class NtWindowListener
{
public:
    virtual ~NtWindowListener() = default;
    /// The window has this much room for its content now, in pixels.
    virtual void onResized(int width, int height) = 0;
    /// Escape was pressed and no widget wanted it.
    virtual void onEscape() = 0;
    /// The window manager asked the window to close. The window stays as it is.
    virtual void onCloseRequested() = 0;
};

/// Native window. It has one content peer, the root of the peers in it; where the content is larger than the window,
/// the user can scroll it.
class NtWindow
{
public:
    NtWindow() = default;
    NtWindow(NtWindow const&) = delete;
    NtWindow& operator=(NtWindow const&) = delete;
    virtual ~NtWindow() = default;

    /// Borrowed: lives as long as the window.
    virtual NtContainer& getContent() = 0;

    /// Size of the content in pixels.
    virtual void setContentSize(int width, int height) = 0;

    /// Shows the window, activates it and makes it modal to all others.
    virtual void show() = 0;
    virtual void hide() = 0;
    virtual void redraw() = 0;

    /// Drops the input that is still queued for the window.
    virtual void flushInput() = 0;
};

/// The window of the application, which made it with Qt itself.
class NtMainWindow : public NtWindow
{
public:
    /// Keeps input from what is the application's own in the window, but not from what the host has in it, until
    /// `admitInput`. Nobody has the keyboard after the first; after the second the front-most that takes input has it.
    virtual void refuseInput() = 0;
    virtual void admitInput() noexcept = 0;
};

} // namespace Kv
