#include "ui/uiWidget.h"

#include "gfx/wsThread.h"
#include "native/ntPlatform.h"
#include "resmgt/liStringUtil.h"
#include "ui/uiContainer.h"
#include "ui/uiResTable.h"

#include <utility>

namespace Kv
{

UiWidget::UiWidget(std::string name) : _name(std::move(name))
{
    requireUiThread();
    LiStringUtil::requireUtf8(_name, "Widget name");
}

UiWidget::~UiWidget() = default;

RttiType const& UiWidget::getClassType()
{
    return RttiGenType0<UiWidget>::getInstance();
}

RttiType const& UiWidget::getRttiType() const
{
    return getClassType();
}

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

void UiWidget::setRect(GeRectangle<int> const& rect, bool)
{
    _rect = rect;
    placePeer();
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
    if (_peer)
        _peer->setEnabled(enabled);
    fire(enabled ? PiWidget::Enable : PiWidget::Disable);
}

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
    return _peer && _displayed && _enabled && _parent && _parent->takesInput();
}

void UiWidget::forgetHandlers()
{
    if (_piWidget)
        _piWidget->clear();
}

void UiWidget::realize(NtPlatform& platform, NtContainer& parent)
{
    _peer = createPeer(platform, parent);
    _peer->setEnabled(_enabled);
    _peer->setTooltip(_tooltip);
    _peer->setDisplayed(_displayed);
}

void UiWidget::dropPeer()
{
    _peer.reset();
}

void UiWidget::placePeer()
{
    if (!_peer || !_parent)
        return;
    GeRectangle<int> const& parent = _parent->getRect();
    _peer->setCell(_rect.xMin - parent.xMin, parent.yMax - _rect.yMax, _rect.getWidth(), _rect.getHeight());
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
