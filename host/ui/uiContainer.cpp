#include "uiContainer.h"

#include "ntPlatform.h"
#include "uiLatePeers.h"
#include "uiLayout.h"
#include "uiWidgetElement.h"
#include "uiWidgetFactory.h"
#include "uiWindow.h"
#include "wsNative.h"

#include <algorithm>
#include <utility>

namespace Kv
{

namespace
{

void build(RCShdPtr<UiContainer> const& parent, UiWidgetElement& element)
{
    RCShdPtr<UiContainer> const container = UiContainer::create(parent, element.getName().c_str(), nullptr);
    UiWidgetFactory::createGroup(container, element);
}

UiWidgetKind const registered("Container", &build);

} // namespace

UiContainer::UiContainer(std::string name) : UiWidget(std::move(name)) {}

UiContainer::~UiContainer()
{
    for (RCShdPtr<UiWidget> const& child : _children)
        child->_parent = nullptr;
    UiContainer::dropPeer();
}

RCShdPtr<UiContainer> UiContainer::create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*)
{
    RCShdPtr<UiContainer> container(new UiContainer(name));
    parent->addChild(container);
    return container;
}

UiWindow* UiContainer::getWindow() const
{
    return _window ? _window : UiWidget::getWindow();
}

void UiContainer::show()
{
    UiWidget::show();
    if (takesInput())
        focusFirst();
}

std::vector<RCShdPtr<UiWidget>> const& UiContainer::getChildren() const
{
    requireUiThread();
    return _children;
}

RCShdPtr<UiWidget> UiContainer::findWidget(LiString const& name) const
{
    requireUiThread();
    if (!_namesKnown)
    {
        indexDescendants(_names);
        _namesKnown = true;
    }
    auto const found = _names.find(name.toString());
    return found == _names.end() ? nullptr : found->second;
}

Iterator<RCShdPtr<UiWidget>> UiContainer::findWidgets(PrdPredicate<UiWidget> const& predicate) const
{
    requireUiThread();
    std::vector<RCShdPtr<UiWidget>> found;
    collect(predicate, found);
    return Iterator<RCShdPtr<UiWidget>>(std::move(found));
}

void UiContainer::front(RCShdPtr<UiWidget> const& descendant)
{
    requireUiThread();
    if (descendant->_peer)
        descendant->_peer->raise();
    descendant->cameToFront();
}

void UiContainer::setFocusWidget(RCShdPtr<UiWidget> const& descendant)
{
    requireUiThread();
    if (!descendant->_peer)
        UiLatePeers::getInstance().makeAll();
    if (descendant->_peer && descendant->isKeyboardFocusable())
        descendant->_peer->takeKeyboard();
}

void UiContainer::focusFirst()
{
    if (_native)
        _native->focusFirst();
}

void UiContainer::addChild(RCShdPtr<UiWidget> const& child)
{
    requireUiThread();
    _children.push_back(child);
    child->_parent = this;
    forgetNames();
    if (!_native)
        return;
    try
    {
        child->realize(WsNative::getPlatform(), *_native);
    }
    catch (...)
    {
        // Half a widget is none.
        child->clearParent();
        throw;
    }
}

std::unique_ptr<NtPeer> UiContainer::createPeer(NtPlatform& platform, NtContainer& parent)
{
    NtNoListener nobody;
    std::unique_ptr<NtContainer> peer = platform.create<NtContainer>(parent, getName(), nobody);
    attachNative(platform, *peer);
    return peer;
}

bool UiContainer::takesInput() const
{
    return _window ? isDisplayed() && isEnabled() && _window->isShown() : UiWidget::takesInput();
}

void UiContainer::takeRect(GeRectangle<int> const& rect, bool layOut)
{
    UiWidget::takeRect(rect, layOut);
    if (layOut)
        layOutChildren();
}

void UiContainer::placePeers()
{
    UiWidget::placePeers();
    for (RCShdPtr<UiWidget> const& child : _children)
        child->placePeers();
}

void UiContainer::attachNative(NtPlatform& platform, NtContainer& native)
{
    _native = &native;
    for (RCShdPtr<UiWidget> const& child : _children)
        child->realize(platform, native);
}

void UiContainer::dropPeer()
{
    for (RCShdPtr<UiWidget> const& child : _children)
        child->dropPeer();
    _native = nullptr;
    UiWidget::dropPeer();
}

void UiContainer::forgetHandlers()
{
    UiWidget::forgetHandlers();
    for (RCShdPtr<UiWidget> const& child : _children)
        child->forgetHandlers();
}

void UiContainer::layOutChildren()
{
    UiLayout layout(*this);
    layout.apply();
}

void UiContainer::removeChild(UiWidget* child)
{
    auto const found = std::find_if(_children.begin(), _children.end(),
                                    [child](RCShdPtr<UiWidget> const& candidate) { return candidate.get() == child; });
    if (found == _children.end())
        return;
    forgetNames();
    RCShdPtr<UiWidget> const removed = *found;
    _children.erase(found);
}

void UiContainer::forgetNames()
{
    for (UiContainer* container = this; container; container = container->_parent)
        if (std::exchange(container->_namesKnown, false))
            container->_names = {};
}

void UiContainer::collect(PrdPredicate<UiWidget> const& predicate, std::vector<RCShdPtr<UiWidget>>& found) const
{
    for (RCShdPtr<UiWidget> const& child : _children)
    {
        if (predicate.holds(*child))
            found.push_back(child);
        if (auto const* const container = dynamic_cast<UiContainer const*>(child.get()))
            container->collect(predicate, found);
    }
}

void UiContainer::indexDescendants(std::unordered_map<std::string, UiWidget*>& index) const
{
    for (RCShdPtr<UiWidget> const& child : _children)
    {
        index.emplace(child->getName(), child.get());
        if (auto const* const container = dynamic_cast<UiContainer const*>(child.get()))
            container->indexDescendants(index);
    }
}

} // namespace Kv
