#pragma once

#include "ntToggle.h"
#include "uiPeeredWidget.h"

namespace Kv
{

/// A button that is on or off. Raises `State` when that changes, and `Activate` when the user clicks it.
class KV_API UiDualState : public UiPeeredWidget<NtToggle>
{
public:
    /// A toggle at the end of `parent`. There are no resource tables for the built-in kinds: pass null.
    static RCShdPtr<UiDualState> create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*);

    bool getState() const;

    /// With `notify` the handlers of `State` run, also when the state stays the same.
    void setState(bool state, bool notify);

protected:
    explicit UiDualState(std::string name);

private:
    void showState(NtToggle& peer) override;
    void onToggled(bool state) override;

    bool _state = false;
};

} // namespace Kv
