#include "ui/uiTopLevel.h"

#include "gfx/wsNative.h"
#include "resmgt/liStringUtil.h"
#include "ui/uiPushButton.h"
#include "ui/uiWidgetPredicate.h"

#include <algorithm>

namespace Kv
{

namespace
{

/// Container of all widgets of a window.
class RootContainer : public UiContainer
{
public:
    RootContainer() : UiContainer("root") {}
};

/// True if neither the widget nor what holds it is hidden.
bool isDisplayedThroughout(UiWidget const& widget)
{
    RCShdPtr<UiContainer> const parent = widget.getParent();
    return widget.isDisplayed() && (!parent || isDisplayedThroughout(*parent));
}

/// By how much the widgets of a container stand out of it, at any depth, in pixels.
GeVector2<int> measureOverflow(UiContainer const& container)
{
    GeRectangle<int> const& frame = container.getRect();
    GeVector2<int> most;
    for (RCShdPtr<UiWidget> const& child : container.getChildren())
    {
        GeRectangle<int> const& rect = child->getRect();
        most.x = std::max({most.x, rect.xMax - frame.xMax, frame.xMin - rect.xMin});
        most.y = std::max({most.y, rect.yMax - frame.yMax, frame.yMin - rect.yMin});
        if (auto const* const inner = dynamic_cast<UiContainer const*>(child.get()))
        {
            GeVector2<int> const within = measureOverflow(*inner);
            most.x = std::max(most.x, within.x);
            most.y = std::max(most.y, within.y);
        }
        else if (std::optional<UiConstraint> const& constraint = child->getConstraint();
                 constraint && constraint->getEdge(UiConstraint::X1).target != UiConstraint::OwnOpposite &&
                 constraint->getEdge(UiConstraint::X2).target != UiConstraint::OwnOpposite)
            most.x = std::max(most.x, child->getLeastWidth() - rect.getWidth());
    }
    return most;
}

} // namespace

UiTopLevel::UiTopLevel(char const* name, char const* title, RCShdPtr<WsWindowStyle> const& style)
    : UiWidget(name), _title(title), _style(style), _root(makeShd<RootContainer>()), _self(this, [](UiTopLevel*) {})
{
    LiStringUtil::requireUtf8(_title, "Window title");
    UiWidget::display(false);
    _root->_window = this;
}

UiTopLevel::~UiTopLevel()
{
    // Nobody finds the window any more, whatever its end brings about.
    _self.reset();
    dropNative();
    _root->_window = nullptr;
}

RCShdPtr<UiTopLevel> UiTopLevel::create(char const* name, char const* title, RCShdPtr<WsWindowStyle> const& style,
                                        UiResTable const*)
{
    return RCShdPtr<UiTopLevel>(new UiTopLevel(name, title, style));
}

RttiType const& UiTopLevel::getClassType()
{
    return RttiGenType1<UiTopLevel, UiWidget>::getInstance();
}

RttiType const& UiTopLevel::getRttiType() const
{
    return getClassType();
}

UiWindow* UiTopLevel::getWindow() const
{
    return const_cast<UiTopLevel*>(this);
}

bool UiTopLevel::redraw()
{
    if (isShown())
        _osWindow->getNative().redraw();
    return isShown();
}

void UiTopLevel::display(bool displayed)
{
    requireUiThread();
    if (displayed && !_osWindow)
        makeNative();
    UiWidget::display(displayed);
    if (displayed)
        _osWindow->getNative().show();
    else if (_osWindow)
        _osWindow->getNative().hide();
}

std::unique_ptr<NtPeer> UiTopLevel::createPeer(NtPlatform&, NtContainer&)
{
    return nullptr;
}

void UiTopLevel::makeNative()
{
    NtPlatform& platform = WsNative::getPlatform();
    std::shared_ptr<UiTopLevel> const owner = _owner.lock();
    NtWindow* const nativeOwner = owner && owner->_osWindow ? &owner->_osWindow->getNative() : nullptr;
    _osWindow = makeShd<WsWindow>(
        platform.createWindow(getName(), _title, _root->getName(), _style->getFrame(), nativeOwner, *this));
    try
    {
        _root->attachNative(platform, _osWindow->getNative().getContent());
    }
    catch (...)
    {
        dropNative();
        throw;
    }
}

void UiTopLevel::dropNative()
{
    _root->dropPeer();
    _osWindow.reset();
}

void UiTopLevel::onResized(int width, int height)
{
    RCShdPtr<UiTopLevel> const self(this);
    _root->setRect({0, width, 0, height}, true);
    GeVector2<int> const overflow = measureOverflow(*_root);
    if (overflow.x > 0 || overflow.y > 0)
        _root->setRect({0, width + overflow.x, 0, height + overflow.y}, true);
    _osWindow->getNative().setContentSize(_root->getRect().getWidth(), _root->getRect().getHeight());
}

void UiTopLevel::onEscape()
{
    RCShdPtr<UiTopLevel> const self(this);
    if (RCShdPtr<UiPushButton> const button = findEscapeButton())
        button->press();
}

void UiTopLevel::onCloseRequested()
{
    RCShdPtr<UiTopLevel> const self(this);
    if (RCShdPtr<UiPushButton> const button = findEscapeButton())
        button->press();
    else
        WsNative::getPlatform().endLoop();
}

RCShdPtr<UiPushButton> UiTopLevel::findEscapeButton() const
{
    PrdPredicate<UiWidget> const isReachable(&isDisplayedThroughout);
    Iterator<RCShdPtr<UiWidget>> buttons =
        _root->findWidgets(UiWidgetPredicate::isType(UiPushButton::getClassType()) && isReachable);
    RCShdPtr<UiPushButton> button;
    for (buttons.first(); !buttons.atEnd(); buttons.next())
    {
        button = dynamicCast<UiPushButton>(buttons.item());
        if (button->getLabel().getString() == "Cancel")
            return button;
    }
    return buttons.getCardinality() == 1 ? button : nullptr;
}

} // namespace Kv
