#include "uiMoveContainer.h"

#include "ntPlatform.h"
#include "uiEscapeButton.h"
#include "uiLayout.h"
#include "uiWindow.h"
#include "wsNative.h"

#include <algorithm>
#include <tuple>
#include <utility>

namespace Kv
{

namespace
{

// The part of a container that always stays within reach, in pixels of its width, and of its height from its top edge.
constexpr int gripWidth = 48;
constexpr int gripHeight = 24;

/// The number within the limits that is nearest; the upper limit wins where they leave nothing.
int keepWithin(int number, int low, int high)
{
    return std::min(std::max(number, low), high);
}

} // namespace

UiMoveContainer::UiMoveContainer(char const* name)
    : UiContainer(name), _moveCb(this, &UiMoveContainer::onPointerMoved),
      _downCb(this, &UiMoveContainer::onPointerDown), _upCb(this, &UiMoveContainer::onPointerUp)
{
    setPointerMoveCb(&_moveCb);
    setPointerDownCb(&_downCb);
    setPointerUpCb(&_upCb);
}

UiMoveContainer::~UiMoveContainer()
{
    UiMoveContainer::dropPeer();
}

RCShdPtr<UiMoveContainer> UiMoveContainer::create(RCShdPtr<UiContainer> const& parent, char const* name,
                                                  UiResTable const*)
{
    RCShdPtr<UiMoveContainer> container(new UiMoveContainer(name));
    parent->addChild(container);
    container->cameToFront();
    return container;
}

void UiMoveContainer::follow(UiContainer const& parent, GeRectangle<int> const& before)
{
    for (RCShdPtr<UiWidget> const& child : parent.getChildren())
        if (auto* const floating = dynamic_cast<UiMoveContainer*>(child.get()))
            floating->setRect(floating->getFollowing(parent.getRect(), before), true);
}

GeRectangle<int> UiMoveContainer::getFrame() const
{
    GeRectangle<int> const cell = getCell();
    return {cell.xMin, cell.xMin + _contentSize.x, cell.yMax - _contentSize.y, cell.yMax};
}

void UiMoveContainer::display(bool displayed)
{
    if (!displayed)
        _drag.reset();
    UiContainer::display(displayed);
}

void UiMoveContainer::show()
{
    if (!isDisplayed())
        UiLatePeers::getInstance().makeAll();
    if (!_waiting)
    {
        layOutChildren();
        placePeers();
    }
    UiContainer::show();
}

void UiMoveContainer::arm(EvPointerButtonDownEvent const& event)
{
    if (RCShdPtr<UiContainer> const parent = getParent())
        parent->front(this);
    if (_float && !hasKeyboard())
        _float->resumeKeyboard();
    _drag = Drag{event.getPosition(), getRect()};
}

void UiMoveContainer::mmove(EvPointerMoveEvent const& event)
{
    if (!event.isButtonDown())
        _drag.reset();
    if (!_drag)
        return;
    GeVector2<int> const& now = event.getPosition();
    setRect(getMoved(_drag->rect, {now.x - _drag->from.x, now.y - _drag->from.y}), true);
}

void UiMoveContainer::disarm(EvPointerButtonUpEvent const&)
{
    _drag.reset();
}

void UiMoveContainer::followInputLevel(int level)
{
    _inputLevel = std::min(_inputLevel, level);
    bool const isBlocked = _inputLevel < level;
    if (isBlocked)
        _drag.reset();
    setBlocked(isBlocked);
}

std::unique_ptr<NtPeer> UiMoveContainer::createPeer(NtPlatform& platform, NtContainer& parent)
{
    std::unique_ptr<NtFloat> peer = platform.create<NtFloat>(parent, getName(), *this);
    _float = peer.get();
    _waiting = UiLatePeers::getInstance().add(*this);
    return peer;
}

void UiMoveContainer::fill()
{
    std::list<UiMoveContainer*> taken = UiLatePeers::getInstance().take(*std::exchange(_waiting, std::nullopt));
    bool const isLost = getReferenceCount() == 1;
    RCShdPtr<UiMoveContainer> const self(this);
    if (isLost)
    {
        clearParent();
        return;
    }
    try
    {
        attachNative(WsNative::getPlatform(), *_float);
        layOutChildren();
        placePeers();
    }
    catch (...)
    {
        // Whoever asks next has it filled anew.
        if (_float)
        {
            _float->startAnew();
            _waiting = UiLatePeers::getInstance().putBack(taken);
        }
        throw;
    }
}

void UiMoveContainer::dropPeer()
{
    if (_waiting)
        UiLatePeers::getInstance().remove(*std::exchange(_waiting, std::nullopt));
    _float = nullptr;
    _room.reset();
    UiContainer::dropPeer();
}

bool UiMoveContainer::takesInput() const
{
    return getReferenceCount() > 1 && UiContainer::takesInput();
}

void UiMoveContainer::takeRect(GeRectangle<int> const& rect, bool layOut)
{
    GeRectangle<int> const before = getCell();
    GeRectangle<int> const now = getShown(rect);
    if (now.getWidth() != before.getWidth() || now.getHeight() != before.getHeight())
        _room.reset();
    UiContainer::takeRect(rect, layOut);
}

void UiMoveContainer::placePeers()
{
    UiContainer::placePeers();
    if (_float && !_waiting)
        _float->setContentSize(_contentSize.x, _contentSize.y);
}

void UiMoveContainer::layOutChildren()
{
    GeVector2<int> const given{getRect().getWidth(), getRect().getHeight()};
    GeVector2<int> room = _room.value_or(given);
    if (!(getCell() == getRect()))
        room = {std::max(room.x, given.x), std::max(room.y, given.y)};
    _contentSize = room;
    UiContainer::layOutChildren();
    GeVector2<int> const overflow = UiLayout::measureOverflow(*this);
    if (overflow.x > 0 || overflow.y > 0)
    {
        _contentSize = {room.x + overflow.x, room.y + overflow.y};
        UiContainer::layOutChildren();
    }
}

void UiMoveContainer::cameToFront()
{
    UiWindow const* const window = getWindow();
    _inputLevel = window ? window->getInputLevel() : 0;
    setBlocked(false);
}

GeRectangle<int> UiMoveContainer::getShown(GeRectangle<int> const& rect) const
{
    GeRectangle<int> const room = getParent() ? getParent()->getRect() : rect;
    bool const isWide = rect.getWidth() > room.getWidth();
    bool const isHigh = rect.getHeight() > room.getHeight();
    GeRectangle<int> shown = rect;
    // A scroll bar stands beside what it was given, if it can: else it would bring the other bar too.
    int const bar = _float ? _float->getBarThickness() : 0;
    if (isWide && rect.getHeight() + bar <= room.getHeight())
        shown.yMin -= bar;
    if (isHigh && rect.getWidth() + bar <= room.getWidth())
        shown.xMax += bar;
    if (isWide)
        std::tie(shown.xMin, shown.xMax) = std::tie(room.xMin, room.xMax);
    if (isHigh)
        std::tie(shown.yMin, shown.yMax) = std::tie(room.yMin, room.yMax);
    return shown;
}

GeRectangle<int> UiMoveContainer::getMoved(GeRectangle<int> const& rect, GeVector2<int> const& by) const
{
    GeRectangle<int> const room = getParent() ? getParent()->getRect() : rect;
    int const width = rect.getWidth();
    int const height = rect.getHeight();
    int const grip = std::min(gripWidth, width);
    int left = rect.xMin;
    if (width <= room.getWidth())
        left = keepWithin(left + by.x, room.xMin + grip - width, room.xMax - grip);
    int top = rect.yMax;
    if (height <= room.getHeight())
        top = keepWithin(top + by.y, room.yMin + gripHeight, room.yMax);
    return {left, left + width, top - height, top};
}

GeRectangle<int> UiMoveContainer::getFollowing(GeRectangle<int> const& now, GeRectangle<int> const& before) const
{
    int const width = getRect().getWidth();
    int const height = getRect().getHeight();
    int left = getRect().xMin + now.xMin - before.xMin;
    int top = getRect().yMax + now.yMax - before.yMax;
    // The user has seen it from edge to edge, and still does where there is room for that now.
    if (width > before.getWidth() && width <= now.getWidth())
        left = keepWithin(left, now.xMin, now.xMax - width);
    if (height > before.getHeight() && height <= now.getHeight())
        top = keepWithin(top, now.yMin + height, now.yMax);
    return getMoved({left, left + width, top - height, top}, {0, 0});
}

void UiMoveContainer::onPointerMoved(EvEvent& event)
{
    mmove(dynamic_cast<EvPointerMoveEvent&>(event));
}

void UiMoveContainer::onPointerDown(EvEvent& event)
{
    arm(dynamic_cast<EvPointerButtonDownEvent&>(event));
}

void UiMoveContainer::onPointerUp(EvEvent& event)
{
    disarm(dynamic_cast<EvPointerButtonUpEvent&>(event));
}

void UiMoveContainer::onResized(int width, int height)
{
    RCShdPtr<UiMoveContainer> const self(this);
    _room = {width, height};
    layOutChildren();
    placePeers();
}

void UiMoveContainer::onEscape()
{
    RCShdPtr<UiMoveContainer> const self(this);
    if (RCShdPtr<UiPushButton> const button = findEscapeButton(*this))
        button->press();
}

void UiMoveContainer::onMoveWanted(int x, int y)
{
    RCShdPtr<UiMoveContainer> const self(this);
    setRect(getMoved(getRect(), {x, -y}), true);
}

} // namespace Kv
