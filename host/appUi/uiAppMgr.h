#pragma once

#include "appUi/kvAppUiExport.h"
#include "base/rcShdPtr.h"
#include "ui/uiTopLevel.h"

#include <memory>
#include <vector>

namespace Kv
{

/// Knows the windows of the application, and in a standalone interpreter those that scripts open on their own.
class KVAPPUI_API UiAppMgr
{
public:
    static UiAppMgr& getInstance();

    /// The application's window. Null in a standalone interpreter, also while a window of a script's own is told.
    RCShdPtr<UiTopLevel> getTopLevel() const;

    /// Tells of a window of its own that is about to be shown. It stays above the one told before it that is still
    /// shown, and is only remembered, not kept.
    void setTopLevel(RCShdPtr<UiTopLevel> const& window);

    /// Tells that a window told before has been hidden: all that are no longer shown are forgotten.
    void releaseTopLevel();

private:
    void forgetHidden();

    /// Told and not yet released, the latest last.
    std::vector<std::weak_ptr<UiTopLevel>> _told;
};

} // namespace Kv
