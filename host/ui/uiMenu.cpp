#include "uiMenu.h"

#include "text/liString.h"
#include "uiContainer.h"
#include "uiWidgetElement.h"
#include "uiWidgetFactory.h"

#include <utility>

namespace Kv
{

namespace
{

void build(RCShdPtr<UiContainer> const& parent, UiWidgetElement& element)
{
    RCShdPtr<UiMenu> const menu = UiMenu::create(parent, element.getName().c_str(), nullptr);
    menu->setAlign(element.takeAlign(NtAlign::Left));
    for (std::string const& entry : element.takeTexts("MenuString"))
        menu->append(entry.c_str());
    if (std::optional<int> const selection = element.takeInt("Selection"))
        menu->setSelection(*selection, false);
}

UiWidgetKind const registered("Menu", &build);

} // namespace

UiMenu::UiMenu(std::string name) : UiPeeredWidget(std::move(name)) {}

RCShdPtr<UiMenu> UiMenu::create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*)
{
    RCShdPtr<UiMenu> menu(new UiMenu(name));
    parent->addChild(menu);
    return menu;
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
    if (NtMenu* const peer = getPeer())
        peer->removeAll();
}

void UiMenu::append(char const* entry)
{
    requireUiThread();
    LiStringUtil::requireUtf8(entry, "Menu entry");
    _entries.emplace_back(entry);
    if (NtMenu* const peer = getPeer())
        peer->append(entry);
}

void UiMenu::setSelection(int index, bool notify)
{
    requireUiThread();
    RCShdPtr<UiMenu> const self(this);
    _selection = index >= 0 && static_cast<std::size_t>(index) < _entries.size() ? index : -1;
    if (NtMenu* const peer = getPeer())
        peer->select(_selection);
    if (notify)
        fire(PiWidget::ValueChanged);
}

void UiMenu::setAlign(NtAlign align)
{
    requireUiThread();
    _align = align;
    if (NtMenu* const peer = getPeer())
        peer->setAlign(align);
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

void UiMenu::showState(NtMenu& peer)
{
    for (std::string const& entry : _entries)
        peer.append(entry);
    peer.select(_selection);
    peer.setAlign(_align);
}

} // namespace Kv
