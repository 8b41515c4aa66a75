#include "uiWidget.h"

#include "ntPlatform.h"
#include "text/liString.h"
#include "uiContainer.h"
#include "uiLatePeers.h"
#include "uiPointerCallbacks.h"
#include "uiResTable.h"
#include "uiWindow.h"
#include "wsThread.h"

#include <utility>

namespace Kv
{

LiString const UiWidget::DefaultFrame("default");
char const* const UiWidget::BackgroundColor = "background";

UiWidget::UiWidget(std::string name) : _name(std::move(name))
{
    requireUiThread();
    LiStringUtil::requireUtf8(_name, "Widget name");
}

UiWidget::~UiWidget() = default;

std::string const& UiWidget::getName() const
{
    return _name;
}

RCShdPtr<UiContainer> UiWidget::getParent() const
{
    return _parent;
}

UiWindow* UiWidget::getWindow() const
{
    return _parent ? _parent->getWindow() : nullptr;
}

RCShdPtr<PiWidget> UiWidget::getPiWidget()
{
    if (!_piWidget)
        _piWidget = makeShd<PiWidget>();
    return _piWidget;
}

int UiWidget::getLeastWidth() const
{
    return 56;
}

GeRectangle<int> const& UiWidget::getRect() const
{
    return _rect;
}

void UiWidget::setRect(GeRectangle<int> const& rect, bool layOut)
{
    takeRect(rect, layOut);
    placePeers();
}

void UiWidget::takeRect(GeRectangle<int> const& rect, bool)
{
    _rect = rect;
}

void UiWidget::setConstraint(UiConstraint const& constraint)
{
    _constraint = constraint;
}

bool UiWidget::isDisplayed() const
{
    return _displayed;
}

void UiWidget::display(bool displayed)
{
    requireUiThread();
    _displayed = displayed;
    if (_peer)
        _peer->setDisplayed(displayed);
}

void UiWidget::show()
{
    display(true);
}

void UiWidget::hide()
{
    if (WsThread::isCurrent())
        display(false);
    else
        _displayed = false;
}

bool UiWidget::isEnabled() const
{
    return _enabled;
}

void UiWidget::setEnabled(bool enabled)
{
    requireUiThread();
    if (enabled == _enabled)
        return;
    _enabled = enabled;
    enablePeer();
    fire(enabled ? PiWidget::Enable : PiWidget::Disable);
}

void UiWidget::setBlocked(bool blocked)
{
    requireUiThread();
    _blocked = blocked;
    enablePeer();
}

void UiWidget::setKeyboardFocusable(bool focusable)
{
    _keyboardFocusable = focusable;
}

bool UiWidget::hasKeyboard() const
{
    UiLatePeers::getInstance().makeAll();
    return _peer && _peer->hasKeyboard();
}

bool UiWidget::holdsValue() const
{
    UiLatePeers::getInstance().makeAll();
    return _peer && _peer->holdsValue();
}

void UiWidget::setFrame(RCShdPtr<UiFrame> const& frame, LiString const& name)
{
    requireUiThread();
    if (name != DefaultFrame)
        throw ExBase(__FILE__, __LINE__, "A widget has no frame \"" + name.toString() + "\"");
    _frame = frame;
    showLook();
}

void UiWidget::setColor(char const* name, CoRgbColorTyped<float> const& color)
{
    requireUiThread();
    if (LiString(name) != LiString(BackgroundColor))
        throw ExBase(__FILE__, __LINE__, std::string("A widget has no colour \"") + name + "\"");
    _background = color;
    showLook();
}

void UiWidget::setPointerMoveCb(CbHandler<EvEvent>* handler)
{
    getPointerCallbacks().setMoveCb(handler);
}

void UiWidget::setPointerDownCb(CbHandler<EvEvent>* handler)
{
    getPointerCallbacks().setDownCb(handler);
}

void UiWidget::setPointerUpCb(CbHandler<EvEvent>* handler)
{
    getPointerCallbacks().setUpCb(handler);
}

void UiWidget::arm(EvPointerButtonDownEvent const&) {}

void UiWidget::mmove(EvPointerMoveEvent const&) {}

void UiWidget::disarm(EvPointerButtonUpEvent const&) {}

void UiWidget::clearParent()
{
    if (UiContainer* const parent = std::exchange(_parent, nullptr))
    {
        dropPeer();
        forgetHandlers();
        parent->removeChild(this);
    }
}

void UiWidget::setTooltip(std::string const& text)
{
    requireUiThread();
    _tooltip = text;
    if (_peer)
        _peer->setTooltip(text);
}

void UiWidget::setWidgetResTable(RCShdPtr<UiWidget> const& widget, std::string const& resourceName)
{
    UiResTable const table = UiResTable::load(resourceName);
    if (std::optional<std::string> const tooltip = table.findTooltip(widget->getName()))
        widget->setTooltip(*tooltip);
}

void UiWidget::requireUiThread() const
{
    WsThread::require(_name.c_str());
}

void UiWidget::fire(PiWidget::EventType type)
{
    if (RCShdPtr<PiWidget> const piWidget = _piWidget)
        piWidget->fire(type);
}

bool UiWidget::takesInput() const
{
    return _peer && _displayed && _enabled && !_blocked && _parent && _parent->takesInput();
}

void UiWidget::forgetHandlers()
{
    if (_piWidget)
        _piWidget->clear();
    if (_pointerCallbacks)
        _pointerCallbacks->clear();
}

GeVector2<int> UiWidget::flipY(int x, int y) const
{
    UiWindow const* const window = getWindow();
    return {x, window ? window->getRootContainer()->getRect().yMax - y : -y};
}

void UiWidget::realize(NtPlatform& platform, NtContainer& parent)
{
    _peer = createPeer(platform, parent);
    if (!_enabled || _blocked)
        enablePeer();
    if (!_tooltip.empty())
        _peer->setTooltip(_tooltip);
    if (_frame || _background)
        showLook();
    if (_pointerCallbacks)
        _peer->setPointerListener(*_pointerCallbacks);
    if (!_displayed)
        _peer->setDisplayed(false);
}

void UiWidget::dropPeer()
{
    _peer.reset();
}

void UiWidget::placePeers()
{
    if (!_peer || !_parent)
        return;
    GeRectangle<int> const parent = _parent->getFrame();
    GeRectangle<int> const cell = getCell();
    _peer->setCell(cell.xMin - parent.xMin, parent.yMax - cell.yMax, cell.getWidth(), cell.getHeight());
}

void UiWidget::enablePeer()
{
    if (_peer)
        _peer->setEnabled(_enabled && !_blocked);
}

void UiWidget::showLook()
{
    if (!_peer)
        return;
    _peer->setLineBelow(_frame && _frame->hasBottomLine());
    if (_background)
        _peer->setBackground({_background->red, _background->green, _background->blue});
}

UiPointerCallbacks& UiWidget::getPointerCallbacks()
{
    requireUiThread();
    if (!_pointerCallbacks)
    {
        _pointerCallbacks = std::make_unique<UiPointerCallbacks>(this);
        if (_peer)
            _peer->setPointerListener(*_pointerCallbacks);
    }
    return *_pointerCallbacks;
}

RCShdPtr<RCBase<LkCounter<int>>> const* UiWidget::getClientDataListPtr() const
{
    return _clientData.data();
}

int UiWidget::getClientDataListSize() const
{
    return static_cast<int>(_clientData.size());
}

void UiWidget::addClientData(RCShdPtr<RCBase<LkCounter<int>>> const& data)
{
    requireUiThread();
    _clientData.push_back(data);
}

} // namespace Kv
