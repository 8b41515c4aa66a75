#pragma once

#include "uiContainer.h"
#include "uiWindow.h"
#include "wsWindow.h"

#include <memory>
#include <string>

namespace Kv
{

/// A window of its own on the screen, with the tree of widgets in it. Escape, and a window manager that asks it to
/// close, press the button that `findEscapeButton` gives; one that is disabled does nothing then. Where there is none,
/// a request to close ends the innermost message loop, but not where the window needs an answer.
class KV_API UiTopLevel : public UiWidget, public UiWindow, protected NtWindowListener
{
public:
    /// A window that is not yet shown. Makes no native window, which comes with the first show.
    static RCShdPtr<UiTopLevel> create(char const* name, char const* title, RCShdPtr<WsWindowStyle> const& style,
                                       UiResTable const*);

    ~UiTopLevel() override;

    UiWindow* getWindow() const override;
    RCShdPtr<UiContainer> getRootContainer() const override;
    RCShdPtr<WsWindow> getOSWindow() const override;
    bool isShown() const override { return _osWindow && isDisplayed(); }
    bool redraw() override;

    /// Shows and hides the window. Throws an `ExBase` that says why where windows cannot be shown; nothing has changed
    /// then.
    void display(bool displayed) override;

    /// The window that this one stays above once it is shown; borrowed only for as long as it lives. Null for none.
    void setOwner(std::weak_ptr<UiTopLevel> owner) { _owner = std::move(owner); }

    /// A pointer that tells when the window is gone, and does not keep it.
    std::weak_ptr<UiTopLevel> observe() { return _self; }

protected:
    UiTopLevel(char const* name, char const* title, RCShdPtr<WsWindowStyle> const& style);

    std::unique_ptr<NtPeer> createPeer(NtPlatform& platform, NtContainer& parent) override;

    /// The native window, not yet shown.
    virtual std::unique_ptr<NtWindow> createNative(NtPlatform& platform);

    /// Makes the native window, and the peers of all that stands in it.
    void makeNative();

    void onResized(int width, int height) override;

private:
    void dropNative();

    void onEscape() override;
    void onCloseRequested() override;

    std::string _title;
    RCShdPtr<WsWindowStyle> _style;
    RCShdPtr<UiContainer> _root;
    RCShdPtr<WsWindow> _osWindow;
    std::weak_ptr<UiTopLevel> _owner;
    std::shared_ptr<UiTopLevel> _self;
};

} // namespace Kv
