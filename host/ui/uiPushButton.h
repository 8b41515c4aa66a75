#pragma once

#include "ntPeers.h"
#include "uiString.h"
#include "uiWidget.h"

namespace Kv
{

class UiWidgetElement;

/// A button that does something when it is pressed: it raises `Activate` and has no value.
class KV_API UiPushButton : public UiWidget, private NtPushButtonListener
{
public:
    /// A push button at the end of `parent`. There are no resource tables for the built-in kinds: pass null.
    static RCShdPtr<UiPushButton> create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*);

    /// The `PushButton` of a description.
    static void build(RCShdPtr<UiContainer> const& parent, UiWidgetElement& element);

    static RttiType const& getClassType();
    RttiType const& getRttiType() const override;

    /// The text on its face.
    UiString& getLabel() { return _label; }

    /// How the text sits in the widget from left to right.
    void setAlign(NtAlign align);

    /// Does what a click of the user does: nothing where a user could not click.
    void press();

protected:
    explicit UiPushButton(std::string name);

    std::unique_ptr<NtPeer> createPeer(NtPlatform& platform, NtContainer& parent) override;

private:
    void dropPeer() override;
    void showLabel();
    void onPressed() override { press(); }

    UiString _label;
    NtAlign _align = NtAlign::Center;
    NtPushButton* _native = nullptr;
};

} // namespace Kv
