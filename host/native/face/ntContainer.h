#pragma once

#include "geometry.h"
#include "ntPeer.h"

namespace Kv
{

/// Holds other peers.
class NtContainer : public virtual NtPeer
{
public:
    using Listener = NtNoListener;

    /// Gives the keyboard to the first displayed and enabled widget in it that holds a value, as the eye goes; without
    /// one, to its first push button.
    virtual void focusFirst() = 0;
};

/// Hears of a floating container.
class NtFloatListener
{
public:
    virtual ~NtFloatListener() = default;
    /// The container has this much room for its content now, in pixels.
    virtual void onResized(int width, int height) = 0;
    /// Escape was pressed in it and no widget wanted it.
    virtual void onEscape() = 0;
    /// It should move by so many pixels, y growing downward, to bring the widget into view that has the keyboard.
    virtual void onMoveWanted(int x, int y) = 0;
};

/// The property of Qt that tells a floating container from other widgets, to those who look at the screen.
constexpr char const* ntFloatMark = "velmoraFloat";

/// Floats above its siblings and keeps Tab within itself. When it is hidden, the keyboard goes to the front-most that
/// takes input, a float or what else had it, and there to the widget that had it last. Where the content is larger, the
/// user can scroll it.
class NtFloat : public NtContainer
{
public:
    using Listener = NtFloatListener;

    /// Gives the keyboard to the widget in it that had it last, else as `focusFirst` does.
    virtual void resumeKeyboard() = 0;

    /// Size of the content in pixels. Before the first call the content is not shown: what is placed in it until then
    /// costs less.
    virtual void setContentSize(int width, int height) = 0;

    /// What is created in it next stands in a content of its own: the one before could not be filled.
    virtual void startAnew() = 0;

    /// The room that a scroll bar takes beside the content, in pixels.
    virtual int getBarThickness() const = 0;
};

/// Hears of a container whose place the application's own window decides.
class NtPlaceListener
{
public:
    virtual ~NtPlaceListener() = default;
    /// Its place in the window, in pixels, y growing upward from the window's bottom edge.
    virtual void onPlaced(GeRectangle<int> const& place) = 0;
};

} // namespace Kv
