#pragma once

#include "ntPeers.h"
#include "uiString.h"
#include "uiWidget.h"

namespace Kv
{

class UiWidgetElement;

/// A text that the user reads and cannot change.
class KV_API UiLabel : public UiWidget
{
public:
    /// A label at the end of `parent`. There are no resource tables for the built-in kinds: pass null.
    static RCShdPtr<UiLabel> create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*);

    /// The `Label` of a description.
    static void build(RCShdPtr<UiContainer> const& parent, UiWidgetElement& element);

    static RttiType const& getClassType();
    RttiType const& getRttiType() const override;

    /// None: what has no room of the text is left out.
    int getLeastWidth() const override;

    /// The text on its face.
    UiString& getLabel();

    /// How the text sits in the widget from left to right.
    void setAlign(NtAlign align);

protected:
    explicit UiLabel(std::string name);

    std::unique_ptr<NtPeer> createPeer(NtPlatform& platform, NtContainer& parent) override;

private:
    void dropPeer() override;
    void showLabel();

    UiString _label;
    NtAlign _align = NtAlign::Left;
    NtLabel* _native = nullptr;
};

} // namespace Kv
