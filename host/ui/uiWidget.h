#pragma once

#include "coRgbColor.h"
#include "geometry.h"
#include "kvExport.h"
#include "piWidget.h"
#include "pointers/rcShdPtr.h"
#include "text/liString.h"
#include "uiConstraint.h"
#include "uiLook.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace Kv
{

class NtContainer;
class NtPeer;
class NtPlatform;
class EvPointerButtonDownEvent;
class EvPointerButtonUpEvent;
class EvPointerMoveEvent;
class UiContainer;
class UiPointerCallbacks;
class UiResTable;
class UiWindow;

/// Base of the widgets: a counted object in a tree, owned by its parent. It is light; what stands on the screen is its
/// native peer, which it gets when its window is first shown and which follows it from then on.
class KV_API UiWidget : public RCBase<LkCounter<int>>
{
public:
    /// The name of the frame that a widget has in every state.
    static LiString const DefaultFrame;
    /// The name of the colour of a widget's ground.
    static char const* const BackgroundColor;

    ~UiWidget() override;

    std::string const& getName() const;

    /// Null for the root of a window, and for a widget that was taken out of its parent.
    RCShdPtr<UiContainer> getParent() const;

    /// The window that holds the widget, borrowed; null if there is none.
    virtual UiWindow* getWindow() const;

    /// The face for event handlers. Never null.
    RCShdPtr<PiWidget> getPiWidget();

    /// The least width that the widget may get where it follows that of its container, in pixels.
    virtual int getLeastWidth() const;

    /// The place of the widget in its window, in pixels, y growing upward. The layout gives it to a widget with a
    /// constraint, once its window is shown.
    GeRectangle<int> const& getRect() const;

    /// Places the widget, and with `layOut` the widgets in it.
    void setRect(GeRectangle<int> const& rect, bool layOut);

    std::optional<UiConstraint> const& getConstraint() const { return _constraint; }
    void setConstraint(UiConstraint const& constraint);

    /// True if the widget itself is to be seen; it is on the screen if all that hold it are so too.
    bool isDisplayed() const;
    virtual void display(bool displayed);

    virtual void show();

    /// May come from any thread: the end of a widget does not choose its own.
    virtual void hide();

    /// True if the widget itself is enabled; it takes input if all that hold it are so too.
    bool isEnabled() const;

    /// A change runs the handlers of `Enable` or `Disable`.
    void setEnabled(bool enabled);

    /// Keeps input from the widget for a while, or lets it in again; its own enabled state stays as it is.
    void setBlocked(bool blocked);

    /// True if the widget itself can be given the keyboard.
    bool isKeyboardFocusable() const { return _keyboardFocusable; }
    void setKeyboardFocusable(bool focusable);

    /// True if the widget, or one in it, has the keyboard whenever its window has it.
    bool hasKeyboard() const;

    /// True for a kind that holds a value, which the user may have set. Only the screen knows: false elsewhere.
    bool holdsValue() const;

    /// Sets the frame of that name; null takes it away. `DefaultFrame` is the one that there is, another name throws an
    /// `ExBase`.
    void setFrame(RCShdPtr<UiFrame> const& frame, LiString const& name);

    /// Sets the colour of that name. `BackgroundColor` is the one that there is, another name throws an `ExBase`.
    void setColor(char const* name, CoRgbColorTyped<float> const& color);

    /// Sets the handler that runs when the pointer moves on the widget, or the left button goes down or up there. The
    /// handlers are borrowed; null takes one away.
    void setPointerMoveCb(CbHandler<EvEvent>* handler);
    void setPointerDownCb(CbHandler<EvEvent>* handler);
    void setPointerUpCb(CbHandler<EvEvent>* handler);

    /// Begins, goes on with and ends a drag of the widget, for those kinds that can be dragged.
    virtual void arm(EvPointerButtonDownEvent const& event);
    virtual void mmove(EvPointerMoveEvent const& event);
    virtual void disarm(EvPointerButtonUpEvent const& event);

    /// Takes the widget out of its parent, which may end its life, and off the screen. Its handlers, and those of the
    /// widgets in it, are forgotten: their owner may be about to go. May come from any thread.
    void clearParent();

    /// The text that is shown while the pointer rests on the widget.
    std::string const& getTooltip() const { return _tooltip; }
    void setTooltip(std::string const& text);

    /// Gives the widget the tooltip that a resource has under its name; `UiResTable::load` tells how that is found. One
    /// that is not there, or does not name the widget, is no error and changes nothing.
    static void setWidgetResTable(RCShdPtr<UiWidget> const& widget, std::string const& resourceName);

    /// The objects that others have attached to the widget, in the order in which they came. An array, borrowed, valid
    /// until more is attached.
    RCShdPtr<RCBase<LkCounter<int>>> const* getClientDataListPtr() const;
    int getClientDataListSize() const;

    /// Keeps `data` with the widget for as long as it lives.
    void addClientData(RCShdPtr<RCBase<LkCounter<int>>> const& data);

protected:
    /// `name` is UTF-8.
    explicit UiWidget(std::string name);

    /// Throws an `ExBase` on any other thread than that of the user interface.
    void requireUiThread() const;

    /// Runs the handlers of an event.
    void fire(PiWidget::EventType type);

    /// True if a user can reach the widget: on the screen, and neither it nor what holds it hidden or disabled.
    virtual bool takesInput() const;

    /// Makes the native peer, which shows the state of the widget from the start.
    virtual std::unique_ptr<NtPeer> createPeer(NtPlatform& platform, NtContainer& parent) = 0;

    /// Lets the native peer go. A widget that points to it forgets it first.
    virtual void dropPeer();

    /// The place of the native peer in the window, in pixels, y growing upward.
    virtual GeRectangle<int> getCell() const { return _rect; }

    /// As `setRect`, but that nothing on the screen follows before `placePeers`.
    virtual void takeRect(GeRectangle<int> const& rect, bool layOut);

    /// Places the native peer, and those of the widgets in it.
    virtual void placePeers();

    /// The widget has been put above its siblings.
    virtual void cameToFront() {}

    /// A point of the window, in pixels, with y growing downward, as one with y growing upward.
    GeVector2<int> flipY(int x, int y) const;

private:
    friend class UiContainer;
    friend class UiLayout;
    friend class UiPointerCallbacks;

    virtual void forgetHandlers();
    void realize(NtPlatform& platform, NtContainer& parent);
    void enablePeer();
    void showLook();
    UiPointerCallbacks& getPointerCallbacks();

    std::string _name;
    std::string _tooltip;
    UiContainer* _parent = nullptr;
    RCShdPtr<PiWidget> _piWidget;
    std::optional<UiConstraint> _constraint;
    GeRectangle<int> _rect;
    bool _displayed = true;
    bool _enabled = true;
    bool _blocked = false;
    bool _keyboardFocusable = false;
    RCShdPtr<UiFrame> _frame;
    std::optional<CoRgbColorTyped<float>> _background;
    /// Outlives the peer, which knows it.
    std::unique_ptr<UiPointerCallbacks> _pointerCallbacks;
    std::unique_ptr<NtPeer> _peer;
    std::vector<RCShdPtr<RCBase<LkCounter<int>>>> _clientData;
};

} // namespace Kv
