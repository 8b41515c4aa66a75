#include "uiFloatingHandler.h"

#include "uiLabel.h"
#include "uiLook.h"

#include <algorithm>

namespace Kv
{

namespace
{

GeRectangle<int> getMiddle(GeRectangle<int> const& room, GeVector2<int> const& size)
{
    int const width = std::min(size.x, room.getWidth());
    int const height = std::min(size.y, room.getHeight());
    int const left = room.xMin + (room.getWidth() - width) / 2;
    int const bottom = room.yMin + (room.getHeight() - height) / 2;
    return {left, left + width, bottom, bottom + height};
}

} // namespace

UiFloatingHandler::UiFloatingHandler(RCShdPtr<UiContainer> const& parent, char const* name, char const* title,
                                     GeVector2<int> const& size)
    : _moveCb(this, &UiFloatingHandler::onPointerMoved), _armCb(this, &UiFloatingHandler::onPointerDown),
      _disarmCb(this, &UiFloatingHandler::onPointerUp), _container(UiMoveContainer::create(parent, name, nullptr))
{
    _container->hide();
    _container->setRect(getMiddle(parent->getRect(), size), true);
    createTitleBar(title);
}

UiFloatingHandler::~UiFloatingHandler()
{
    _container->clearParent();
}

RCShdPtr<UiMoveContainer> const& UiFloatingHandler::getContainer() const
{
    return _container;
}

void UiFloatingHandler::show()
{
    _container->show();
}

void UiFloatingHandler::hide()
{
    _container->hide();
}

void UiFloatingHandler::createTitleBar(char const* title)
{
    RCShdPtr<UiLabel> const titleBar = UiLabel::create(_container, "titleBar", nullptr);
    titleBar->getLabel().setString(title);
    using Edge = UiConstraint::Edge;
    titleBar->setConstraint(
        UiConstraint({Edge{0, UiConstraint::Pixels, UiConstraint::ParentLow, {}},
                      Edge{-static_cast<float>(titleHeight), UiConstraint::Pixels, UiConstraint::ParentHigh, {}},
                      Edge{0, UiConstraint::Pixels, UiConstraint::ParentHigh, {}},
                      Edge{0, UiConstraint::Pixels, UiConstraint::ParentHigh, {}}}));
    titleBar->setFrame(makeShd<UiFrameLineBottom>(), UiWidget::DefaultFrame);
    titleBar->setColor(UiWidget::BackgroundColor, UiColorRegistry::getInstance().getColor(UiColorRegistry::Grey65));
    titleBar->setPointerMoveCb(&_moveCb);
    titleBar->setPointerDownCb(&_armCb);
    titleBar->setPointerUpCb(&_disarmCb);
}

void UiFloatingHandler::onPointerMoved(EvEvent& event)
{
    _container->mmove(dynamic_cast<EvPointerMoveEvent&>(event));
}

void UiFloatingHandler::onPointerDown(EvEvent& event)
{
    _container->arm(dynamic_cast<EvPointerButtonDownEvent&>(event));
}

void UiFloatingHandler::onPointerUp(EvEvent& event)
{
    _container->disarm(dynamic_cast<EvPointerButtonUpEvent&>(event));
}

} // namespace Kv
