#pragma once

#include "ntPeers.h"
#include "uiWidget.h"

namespace Kv
{

class UiWidgetElement;

/// A button that is on or off. Raises `State` when that changes, and `Activate` when the user clicks it.
class KV_API UiDualState : public UiWidget, private NtToggleListener
{
public:
    /// A toggle at the end of `parent`. There are no resource tables for the built-in kinds: pass null.
    static RCShdPtr<UiDualState> create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*);

    /// The `ToggleButton` of a description.
    static void build(RCShdPtr<UiContainer> const& parent, UiWidgetElement& element);

    static RttiType const& getClassType();
    RttiType const& getRttiType() const override;

    bool getState() const;

    /// With `notify` the handlers of `State` run, also when the state stays the same.
    void setState(bool state, bool notify);

protected:
    explicit UiDualState(std::string name);

    std::unique_ptr<NtPeer> createPeer(NtPlatform& platform, NtContainer& parent) override;

private:
    void dropPeer() override;
    void onToggled(bool state) override;

    bool _state = false;
    NtToggle* _native = nullptr;
};

} // namespace Kv
