#include "ui/uiMoveContainer.h"

#include "native/ntPlatform.h"
#include "ui/uiEscapeButton.h"
#include "ui/uiLayout.h"
#include "ui/uiWindow.h"

#include <algorithm>

namespace Kv
{

namespace
{

// What of a container always stays within reach, in pixels: so much of its width, and so much of it below its top edge.
constexpr int gripWidth = 48;
constexpr int gripHeight = 24;

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

RttiType const& UiMoveContainer::getClassType()
{
    return RttiGenType1<UiMoveContainer, UiContainer>::getInstance();
}

RttiType const& UiMoveContainer::getRttiType() const
{
    return getClassType();
}

void UiMoveContainer::follow(UiContainer const& parent, GeRectangle<int> const& before)
{
    GeRectangle<int> const& now = parent.getRect();
    GeVector2<int> const by{now.xMin - before.xMin, now.yMax - before.yMax};
    for (RCShdPtr<UiWidget> const& child : parent.getChildren())
        if (auto* const floating = dynamic_cast<UiMoveContainer*>(child.get()))
            floating->setRect(floating->getMoved(floating->getRect(), by), true);
}

GeRectangle<int> UiMoveContainer::getFrame() const
{
    GeRectangle<int> const& rect = getRect();
    return {rect.xMin, rect.xMin + _contentSize.x, rect.yMax - _contentSize.y, rect.yMax};
}

void UiMoveContainer::setRect(GeRectangle<int> const& rect, bool layOut)
{
    if (rect.getWidth() != getRect().getWidth() || rect.getHeight() != getRect().getHeight())
        _room.reset();
    UiContainer::setRect(rect, layOut);
}

void UiMoveContainer::show()
{
    layOutChildren();
    UiContainer::show();
}

void UiMoveContainer::arm(EvPointerButtonDownEvent const& event)
void UiMoveContainer::display(bool displayed)
{
    if (!displayed)
        _drag.reset();
    UiContainer::display(displayed);
}

{
    if (RCShdPtr<UiContainer> const parent = getParent())
        parent->front(this);
    if (_float && !hasKeyboard())
        _float->resumeKeyboard();
    _drag = Drag{event.getPosition(), getRect()};
}

void UiMoveContainer::mmove(EvPointerMoveEvent const& event)
{
    if (!_drag)
        return;
    GeVector2<int> const& now = event.getPosition();
    setRect(getMoved(_drag->rect, {now.x - _drag->from.x, now.y - _drag->from.y}), true);
}

void UiMoveContainer::disarm(EvPointerButtonUpEvent const&)
    if (!event.isButtonDown())
        _drag.reset();
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
    std::unique_ptr<NtFloat> peer = platform.createFloat(parent, getName(), *this);
    _float = peer.get();
    attachNative(platform, *peer);
    return peer;
}

void UiMoveContainer::dropPeer()
{
    _float = nullptr;
    _room.reset();
    UiContainer::dropPeer();
}

bool UiMoveContainer::takesInput() const
{
    return getReferenceCount() > 1 && UiContainer::takesInput();
}

void UiMoveContainer::layOutChildren()
{
    GeVector2<int> const room = _room.value_or(GeVector2<int>{getRect().getWidth(), getRect().getHeight()});
    _contentSize = room;
    UiContainer::layOutChildren();
    GeVector2<int> const overflow = UiLayout::measureOverflow(*this);
    if (overflow.x > 0 || overflow.y > 0)
    {
        _contentSize = {room.x + overflow.x, room.y + overflow.y};
        UiContainer::layOutChildren();
    }
    if (_float)
        _float->setContentSize(_contentSize.x, _contentSize.y);
}

void UiMoveContainer::cameToFront()
{
    UiWindow const* const window = getWindow();
    _inputLevel = window ? window->getInputLevel() : 0;
    setBlocked(false);
}

GeRectangle<int> UiMoveContainer::getMoved(GeRectangle<int> const& rect, GeVector2<int> const& by) const
{
    GeRectangle<int> const room = getParent() ? getParent()->getRect() : rect;
    int const width = rect.getWidth();
    int const height = rect.getHeight();
    int const grip = std::min(gripWidth, width);
    int const left = std::min(std::max(rect.xMin + by.x, room.xMin + grip - width), room.xMax - grip);
    int const highest = std::max(room.yMax, room.yMin + height);
    int const top = std::min(std::max(rect.yMax + by.y, room.yMin + gripHeight), highest);
    return {left, left + width, top - height, top};
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

void UiMoveContainer::onFirstTurn()
{
    bool const isLost = getReferenceCount() == 1 && getParent();
    RCShdPtr<UiMoveContainer> const self(this);
    if (isLost)
        clearParent();
    else
        layOutChildren();
}

} // namespace Kv
