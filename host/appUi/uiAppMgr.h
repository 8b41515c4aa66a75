#pragma once

#include "kvExport.h"
#include "pointers/rcShdPtr.h"
#include "uiMainWindow.h"
#include "uiPanel.h"
#include "uiWorkspace.h"

#include <memory>
#include <vector>

namespace Kv
{

/// Knows the windows of the application, and in a standalone interpreter those that scripts open on their own.
class KV_API UiAppMgr
{
public:
    static UiAppMgr& getInstance();

    /// The application's window. Null in a standalone interpreter, also while a window of a script's own is told.
    RCShdPtr<UiTopLevel> getTopLevel() const;

    /// The window in whose root the application's own floating containers stand; null in a standalone interpreter.
    RCShdPtr<UiTopLevel> getMainWindow() const;

    /// The panel of the application's window in which dialogs float; null in a standalone interpreter.
    RCShdPtr<UiPanel> getMainPanel() const;

    /// The selection in the application; null where there is none, and in a standalone interpreter.
    RCShdPtr<SnSelection> getSelection() const;

    /// For the application: from here on it is there, with this window, this panel in it, and what is selected in this
    /// view. Null pointers take it away.
    void setApplication(RCShdPtr<UiMainWindow> const& window, RCShdPtr<UiPanel> const& panel,
                        RCShdPtr<UiView> const& view);

    /// Tells of a window of its own that is about to be shown. It stays above the one told before it that is still
    /// shown, and is only remembered, not kept.
    void setTopLevel(RCShdPtr<UiTopLevel> const& window);

    /// Tells that a window told before has been hidden: all that are no longer shown are forgotten.
    void releaseTopLevel();

private:
    void forgetHidden();

    RCShdPtr<UiMainWindow> _mainWindow;
    RCShdPtr<UiPanel> _mainPanel;
    RCShdPtr<UiView> _view;

    /// Told and not yet released, the latest last.
    std::vector<std::weak_ptr<UiTopLevel>> _told;
};

/// Keeps the application's own widgets from taking input for as long as it lives, while the floating containers that
/// come to the front meanwhile stay usable. The last one to go leaves the application as it was. Without an application
/// it does nothing.
class KV_API UiAppDisabler
{
public:
    UiAppDisabler();
    UiAppDisabler(UiAppDisabler const&) = delete;
    UiAppDisabler& operator=(UiAppDisabler const&) = delete;
    ~UiAppDisabler();

private:
    RCShdPtr<UiMainWindow> _window;
};

} // namespace Kv
