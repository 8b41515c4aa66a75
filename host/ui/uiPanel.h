#pragma once

#include "ntContainer.h"
#include "uiContainer.h"

namespace Kv
{

/// Container that stands where the application's window has it. Floating containers in it keep their distance from its
/// upper left corner.
class KV_API UiPanel : public UiContainer, private NtPlaceListener
{
public:
    /// A panel at the end of `parent`, which is the root of the application's window. `widget` is the application's own
    /// for it.
    static RCShdPtr<UiPanel> create(RCShdPtr<UiContainer> const& parent, char const* name, NtForeignWidget widget);

    ~UiPanel() override;

protected:
    UiPanel(char const* name, NtForeignWidget widget);

    std::unique_ptr<NtPeer> createPeer(NtPlatform& platform, NtContainer& parent) override;

private:
    void onPlaced(GeRectangle<int> const& place) override;

    NtForeignWidget _widget;
};

} // namespace Kv
