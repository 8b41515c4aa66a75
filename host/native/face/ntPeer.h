#pragma once

#include <string>

namespace Kv
{

/// The place of a text in its widget from left to right; from bottom to top it is always centred.
enum class NtAlign
{
    Left,
    Center,
};

/// Colour on the screen, each part from 0 to 1.
struct NtColor
{
    float red = 0;
    float green = 0;
    float blue = 0;
};

/// A widget that the application has made with Qt itself: a `QWidget`. Borrowed; it may go before the peer
/// that adopts it.
struct NtForeignWidget
{
    void* widget = nullptr;
};

/// Hears of the pointer on a widget: its moves and the left button, also outside of the widget for as long as the
/// button that was pressed on it is down. In pixels of the window, y growing downward. The release can go elsewhere:
/// then the next move tells that the button is up.
class NtPointerListener
{
public:
    virtual ~NtPointerListener() = default;
    virtual void onPointerMoved(int x, int y, bool isButtonDown) = 0;
    virtual void onPointerDown(int x, int y) = 0;
    virtual void onPointerUp(int x, int y) = 0;
};

/// Stands for the listener of a peer that has nothing to tell.
class NtNoListener
{
};

/// Native side of one widget: what stands on the screen. Owned by the widget, which tells it what to show and hears of
/// the user through a listener. What the widget tells it never comes back as if the user had done it, and a peer that
/// is hidden or goes away tells nothing.
class NtPeer
{
public:
    NtPeer() = default;
    NtPeer(NtPeer const&) = delete;
    NtPeer& operator=(NtPeer const&) = delete;
    virtual ~NtPeer() = default;

    /// The cell that the layout gives the widget, in pixels of the parent peer, y growing downward.
    virtual void setCell(int x, int y, int width, int height) = 0;

    virtual void setDisplayed(bool displayed) = 0;
    virtual void setEnabled(bool enabled) = 0;

    /// Text shown while the pointer rests on the widget; none when empty.
    virtual void setTooltip(std::string const& text) = 0;

    /// Puts the peer above its siblings.
    virtual void raise() = 0;

    /// Fills the ground behind the widget; its text is black or white then, whichever is easier to read.
    virtual void setBackground(NtColor const& color) = 0;

    /// Draws a line along the bottom edge.
    virtual void setLineBelow(bool drawn) = 0;

    /// Tells of the pointer from now on; the listener is borrowed and outlives the peer. In a floating container the
    /// widget becomes a grip, which stays in place when the content scrolls.
    virtual void setPointerListener(NtPointerListener& listener) = 0;

    /// Gives the widget itself the keyboard.
    virtual void takeKeyboard() = 0;

    /// True if the widget, or one in it, has the keyboard whenever its window has it.
    virtual bool hasKeyboard() const = 0;

    /// True for the kinds that hold a value, which the user may have set.
    virtual bool holdsValue() const = 0;
};

} // namespace Kv
