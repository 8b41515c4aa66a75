#include "uiMenu.h"

#include "ntPlatform.h"
#include "text/liStringUtil.h"
#include "uiContainer.h"
#include "uiWidgetElement.h"

#include <utility>

namespace Kv
{

UiMenu::UiMenu(std::string name) : UiWidget(std::move(name)) {}

RCShdPtr<UiMenu> UiMenu::create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*)
{
    RCShdPtr<UiMenu> menu(new UiMenu(name));
    parent->addChild(menu);
    return menu;
}

void UiMenu::build(RCShdPtr<UiContainer> const& parent, UiWidgetElement& element)
{
    RCShdPtr<UiMenu> const menu = create(parent, element.getName().c_str(), nullptr);
    menu->setConstraint(element.getConstraint());
    menu->setAlign(element.takeAlign(NtAlign::Left));
    for (std::string const& entry : element.takeTexts("MenuString"))
        menu->append(entry.c_str());
    if (std::optional<int> const selection = element.takeInt("Selection"))
        menu->setSelection(*selection, false);
}

RttiType const& UiMenu::getClassType()
{
    return RttiGenType1<UiMenu, UiWidget>::getInstance();
}

RttiType const& UiMenu::getRttiType() const
{
    return getClassType();
}

char const* UiMenu::getStrPtr() const
{
    return _selection < 0 ? nullptr : _entries.at(static_cast<std::size_t>(_selection)).c_str();
}

void UiMenu::removeAll()
{
    requireUiThread();
    _entries.clear();
    _selection = -1;
    if (_native)
        _native->removeAll();
}

void UiMenu::append(char const* entry)
{
    requireUiThread();
    LiStringUtil::requireUtf8(entry, "Menu entry");
    _entries.emplace_back(entry);
    if (_native)
        _native->append(entry);
}

void UiMenu::setSelection(int index, bool notify)
{
    requireUiThread();
    RCShdPtr<UiMenu> const self(this);
    _selection = index >= 0 && static_cast<std::size_t>(index) < _entries.size() ? index : -1;
    if (_native)
        _native->select(_selection);
    if (notify)
        fire(PiWidget::ValueChanged);
}

void UiMenu::setAlign(NtAlign align)
{
    requireUiThread();
    _align = align;
    if (_native)
        _native->setAlign(align);
}

void UiMenu::onPicked(int index)
{
    RCShdPtr<UiMenu> const self(this);
    if (!takesInput())
        return;
    bool const changed = index != _selection;
    _selection = index;
    if (changed)
        fire(PiWidget::ValueChanged);
    fire(PiWidget::Activate);
}

std::unique_ptr<NtPeer> UiMenu::createPeer(NtPlatform& platform, NtContainer& parent)
{
    std::unique_ptr<NtMenu> peer = platform.createMenu(parent, getName(), *this);
    for (std::string const& entry : _entries)
        peer->append(entry);
    peer->select(_selection);
    peer->setAlign(_align);
    _native = peer.get();
    return peer;
}

void UiMenu::dropPeer()
{
    _native = nullptr;
    UiWidget::dropPeer();
}

} // namespace Kv
