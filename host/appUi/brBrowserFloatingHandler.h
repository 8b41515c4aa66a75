#pragma once

#include "brBrowser.h"
#include "iterator.h"
#include "uiFloatingHandler.h"
#include "uiPushButton.h"

namespace Kv
{

/// Floating browser with an OK and a Cancel button, for picking a path. Enter on a file, and a double click, press OK;
/// Escape presses Cancel, which hides the browser.
class KV_API BrBrowserFloatingHandler : public UiFloatingHandler
{
public:
    /// A hidden browser in the middle of `parent`, at `place`, where the browsables of `selection` are selected. An
    /// empty place is the root of the file system; the selection can be null. The one scheme that there is a browser
    /// for is that of the file system: throws an `ExBase` that names any other.
    BrBrowserFloatingHandler(RCShdPtr<UiContainer> const& parent, char const* title,
                             RCShdPtr<SnSelection> const& selection, Vector<LiString> const& schemes,
                             LiString const& place, Bookmarkable);
    ~BrBrowserFloatingHandler() override;

    RCShdPtr<BrBrowser> const& getBrowser() const;

    /// `handler`, borrowed, runs when OK is pressed, and not on Cancel; the browser stays open unless it hides it. With
    /// a path typed that leads nowhere OK does not get so far.
    void setActivateCb(CbHandler<EvEvent>* handler);

    /// The flag of a loop that runs the browser: true but between `show` and `hide`.
    bool volatile* isClosed();
    bool const volatile* isClosedConst() const;

    void show() override;
    void hide() override;

private:
    RCShdPtr<UiPushButton> createButton(char const* label, float right, UiEventCallback<BrBrowserFloatingHandler>& cb);
    void onFileActivated(EvEvent& event);
    void onOk(EvEvent& event);
    void onCancel(EvEvent& event);

    UiEventCallback<BrBrowserFloatingHandler> _fileCb;
    UiEventCallback<BrBrowserFloatingHandler> _okCb;
    UiEventCallback<BrBrowserFloatingHandler> _cancelCb;
    CbHandler<EvEvent>* _activateCb = nullptr;
    RCShdPtr<BrBrowser> _browser;
    RCShdPtr<UiPushButton> _ok;
    bool volatile _closed = true;
};

} // namespace Kv
