#pragma once

#include "geRectangle.h"

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace Kv
{

/// How a text sits in its widget from left to right; from bottom to top it is always centred.
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

/// A widget that the application has made with the toolkit itself: a `QWidget`. Borrowed; it may go before the peer
/// that adopts it.
struct NtForeignWidget
{
    void* widget = nullptr;
};

/// What a widget hears of the pointer: its moves and the left button, also outside of the widget for as long as the
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

/// Holds other peers.
class NtContainer : public virtual NtPeer
{
public:
    /// Gives the keyboard to the first displayed and enabled widget in it that holds a value, as the eye goes; without
    /// one, to its first push button.
    virtual void focusFirst() = 0;
};

/// What a floating container hears.
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
    /// The loop has come around for the first time since the peer was made.
    virtual void onFirstTurn() = 0;
};

/// Floats above its siblings and keeps Tab within itself. When it is hidden, the keyboard goes to the front-most that
/// takes input, a float or what else had it, and there to the widget that had it last. Where the content is larger, the
/// user can scroll it.
class NtFloat : public NtContainer
{
public:
    /// Gives the keyboard to the widget in it that had it last, else as `focusFirst` does.
    virtual void resumeKeyboard() = 0;

    /// Size of the content in pixels.
    virtual void setContentSize(int width, int height) = 0;

    /// How much room a scroll bar takes beside the content, in pixels.
    virtual int getBarThickness() const = 0;
};

/// What a container hears whose place the application's own window decides.
class NtPlaceListener
{
public:
    virtual ~NtPlaceListener() = default;
    /// Its place in the window, in pixels, y growing upward from the window's bottom edge.
    virtual void onPlaced(GeRectangle<int> const& place) = 0;
};

class NtLabel : public virtual NtPeer
{
public:
    virtual void setText(std::string const& text) = 0;
    virtual void setAlign(NtAlign align) = 0;
};

/// What a text field hears of the user.
class NtTextFieldListener
{
public:
    virtual ~NtTextFieldListener() = default;
    virtual void onClicked() = 0;
    virtual void onTextEdited(std::string const& text) = 0;
    /// Enter was pressed.
    virtual void onEditEnded() = 0;
};

class NtTextField : public virtual NtPeer
{
public:
    /// Replaces the text; the text cursor goes to the end, or to the start.
    virtual void setText(std::string const& text, bool cursorAtEnd) = 0;
    virtual void setAlign(NtAlign align) = 0;
};

/// What a toggle hears of the user.
class NtToggleListener
{
public:
    virtual ~NtToggleListener() = default;
    virtual void onToggled(bool state) = 0;
};

class NtToggle : public virtual NtPeer
{
public:
    virtual void setState(bool state) = 0;
};

/// What a menu hears of the user.
class NtMenuListener
{
public:
    virtual ~NtMenuListener() = default;
    /// The user picked an entry, maybe the one that was selected already.
    virtual void onPicked(int index) = 0;
};

class NtMenu : public virtual NtPeer
{
public:
    virtual void removeAll() = 0;
    /// Adds an entry at the end and selects nothing.
    virtual void append(std::string const& entry) = 0;
    /// Selects an entry, or none for -1.
    virtual void select(int index) = 0;
    virtual void setAlign(NtAlign align) = 0;
};

/// What a push button hears of the user.
class NtPushButtonListener
{
public:
    virtual ~NtPushButtonListener() = default;
    virtual void onPressed() = 0;
};

class NtPushButton : public virtual NtPeer
{
public:
    virtual void setText(std::string const& text) = 0;
    virtual void setAlign(NtAlign align) = 0;
};

/// What a browser hears. Names and paths are bytes of the file system.
class NtBrowserListener
{
public:
    virtual ~NtBrowserListener() = default;
    /// The user went to another directory, or the one that was shown is gone. Nothing is selected in it yet.
    virtual void onDirectoryChanged(std::string const& directory) = 0;
    /// Of the entries of the directory, `focus` has the keyboard and `selected`, as they stand on the screen, are
    /// selected; `focus` is one of them, or empty. Of a sequence it is the first file.
    virtual void onSelectionChanged(std::string const& focus, std::vector<std::string> const& selected) = 0;
    /// The user pressed Enter on a file or clicked it twice; it is in focus.
    virtual void onActivated() = 0;
};

/// Shows a directory, and lets the user go from one to another.
class NtBrowser : public virtual NtPeer
{
public:
    /// Shows `directory`, an absolute path, with those of `selected` that are in it, and `focus`, selected.
    virtual void goTo(std::string const& directory, std::string const& focus,
                      std::vector<std::string> const& selected) = 0;

    /// Which files may become part of a numbered sequence, by their names. Called for each file.
    virtual void setCollapsing(std::function<bool(std::string const&)> collapses) = 0;

    /// Whether more than one entry can be selected.
    virtual void setMultiple(bool multiple) = 0;

    /// Goes where the user has typed without pressing Enter, as Enter would, and the listener hears of it; gives an
    /// empty path. With `takesNew`, where nothing is there but its directory, stays and gives the typed path. Nothing
    /// in all other cases, which the user is told.
    virtual std::optional<std::string> takeTypedPath(bool takesNew) = 0;
};

/// What a window hears of the user.
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

/// The window of the application, which made it with the toolkit itself.
class NtMainWindow : public NtWindow
{
public:
    /// Keeps input from what is the application's own in the window, but not from what the host has in it, until
    /// `admitInput`. Nobody has the keyboard after the first; after the second the front-most that takes input has it.
    virtual void refuseInput() = 0;
    virtual void admitInput() = 0;
};

} // namespace Kv
