#include "uiPanel.h"

#include "ntPlatform.h"
#include "uiMoveContainer.h"

namespace Kv
{

UiPanel::UiPanel(char const* name, NtForeignWidget widget) : UiContainer(name), _widget(widget) {}

UiPanel::~UiPanel()
{
    UiPanel::dropPeer();
}

RCShdPtr<UiPanel> UiPanel::create(RCShdPtr<UiContainer> const& parent, char const* name, NtForeignWidget widget)
{
    RCShdPtr<UiPanel> panel(new UiPanel(name, widget));
    parent->addChild(panel);
    return panel;
}

std::unique_ptr<NtPeer> UiPanel::createPeer(NtPlatform& platform, NtContainer&)
{
    std::unique_ptr<NtContainer> peer = platform.adoptContainer(_widget, *this);
    attachNative(platform, *peer);
    return peer;
}

void UiPanel::onPlaced(GeRectangle<int> const& place)
{
    GeRectangle<int> const before = getRect();
    setRect(place, true);
    UiMoveContainer::follow(*this, before);
}

} // namespace Kv
