#pragma once

#include "evPointerEvent.h"
#include "ntContainer.h"
#include "piWidget.h"
#include "uiContainer.h"
#include "uiLatePeers.h"

#include <optional>

namespace Kv
{

/// Container that floats above its siblings and that the user moves: by the widgets whose pointer events its owner
/// forwards to it, and by all of it that is no widget for input. It stands where it is told to; dragged, it cannot be
/// lost. Where it is wider or higher than its parent, it fills that on the screen, and scrolls. So does what needs more
/// room than it has. Escape in it presses the button that it does in a window.
///
/// The peers of the widgets in it come a little later than its own, as `UiLatePeers` tells. One that nobody but its
/// parent owns goes then: its maker has failed.
class KV_API UiMoveContainer : public UiContainer, private NtFloatListener
{
public:
    /// A floating container at the end of `parent`. There are no resource tables for the built-in kinds: pass null.
    static RCShdPtr<UiMoveContainer> create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*);

    ~UiMoveContainer() override;

    /// The floating containers directly in `parent` keep their distance from its upper left corner, and stay within
    /// reach: `parent` has just been moved from the rectangle `before`.
    static void follow(UiContainer const& parent, GeRectangle<int> const& before);

    GeRectangle<int> getFrame() const override;
    void display(bool displayed) override;
    void show() override;

    /// Brings the container to the front and begins to move it with the pointer. That ends with the release of the
    /// button, wherever that goes, and once the container is hidden or takes no input any more.
    void arm(EvPointerButtonDownEvent const& event) override;
    void mmove(EvPointerMoveEvent const& event) override;
    void disarm(EvPointerButtonUpEvent const& event) override;

    /// Keeps input from it if it came to the front last while fewer than `level` refusals of input were in force.
    /// Those above `level` are over.
    void followInputLevel(int level);

    /// Makes the native peers of the widgets in it, if it waits for them; it goes if nobody but its parent owns it.
    void fill();

protected:
    explicit UiMoveContainer(char const* name);

    std::unique_ptr<NtPeer> createPeer(NtPlatform& platform, NtContainer& parent) override;
    void dropPeer() override;

    /// Not any more once nobody but its parent owns it: who it would call is gone.
    bool takesInput() const override;

    GeRectangle<int> getCell() const override { return getShown(getRect()); }
    void takeRect(GeRectangle<int> const& rect, bool layOut) override;
    void placePeers() override;
    void layOutChildren() override;
    void cameToFront() override;

private:
    struct Drag
    {
        GeVector2<int> from;
        GeRectangle<int> rect;
    };

    /// The part of it that is in sight when it stands at `rect`: where it is larger than the parent, all of that.
    GeRectangle<int> getShown(GeRectangle<int> const& rect) const;

    /// The rectangle moved by so many pixels, y growing upward, as far as it stays within reach. One that fills its
    /// parent does not move.
    GeRectangle<int> getMoved(GeRectangle<int> const& rect, GeVector2<int> const& by) const;

    /// The rectangle after the parent has gone from `before` to `now`.
    GeRectangle<int> getFollowing(GeRectangle<int> const& now, GeRectangle<int> const& before) const;

    void onPointerMoved(EvEvent& event);
    void onPointerDown(EvEvent& event);
    void onPointerUp(EvEvent& event);

    void onResized(int width, int height) override;
    void onEscape() override;
    void onMoveWanted(int x, int y) override;

    UiEventCallback<UiMoveContainer> _moveCb;
    UiEventCallback<UiMoveContainer> _downCb;
    UiEventCallback<UiMoveContainer> _upCb;
    std::optional<Drag> _drag;
    /// The number of refusals of input that were in force when it came to the front last, and still are.
    int _inputLevel = 0;

    /// The room on the screen for the content, beside scroll bars, in pixels; unknown while it is on none.
    std::optional<GeVector2<int>> _room;
    GeVector2<int> _contentSize;
    NtFloat* _float = nullptr;
    /// Its place among those that are to be filled, while it is.
    std::optional<UiLatePeers::Place> _waiting;
};

} // namespace Kv
