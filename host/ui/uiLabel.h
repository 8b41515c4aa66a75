#pragma once

#include "ntLabel.h"
#include "uiPeeredWidget.h"
#include "uiString.h"

namespace Kv
{

/// A text that the user reads and cannot change.
class KV_API UiLabel : public UiPeeredWidget<NtLabel>
{
public:
    /// A label at the end of `parent`. There are no resource tables for the built-in kinds: pass null.
    static RCShdPtr<UiLabel> create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*);

    /// None: what has no room of the text is left out.
    int getLeastWidth() const override;

    /// The text on its face.
    UiString& getLabel();

    /// Places the text in the widget from left to right.
    void setAlign(NtAlign align);

protected:
    explicit UiLabel(std::string name);

private:
    void showState(NtLabel& peer) override;
    void showLabel();

    UiString _label;
    NtAlign _align = NtAlign::Left;
};

} // namespace Kv
