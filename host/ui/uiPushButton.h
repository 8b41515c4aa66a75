#pragma once

#include "ntPushButton.h"
#include "uiPeeredWidget.h"
#include "uiString.h"

namespace Kv
{

/// A button that does something when it is pressed: it raises `Activate` and has no value.
class KV_API UiPushButton : public UiPeeredWidget<NtPushButton>
{
public:
    /// A push button at the end of `parent`. There are no resource tables for the built-in kinds: pass null.
    static RCShdPtr<UiPushButton> create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*);

    /// The text on its face.
    UiString& getLabel() { return _label; }

    /// Places the text in the widget from left to right.
    void setAlign(NtAlign align);

    /// Does what a click of the user does: nothing where a user could not click.
    void press();

protected:
    explicit UiPushButton(std::string name);

private:
    void showState(NtPushButton& peer) override;
    void showLabel();
    void onPressed() override { press(); }

    UiString _label;
    NtAlign _align = NtAlign::Center;
};

} // namespace Kv
