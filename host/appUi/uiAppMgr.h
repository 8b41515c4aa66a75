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

    /// Tells of a window of its own that is about to be shown. It stays above the one told before it, and is only
    /// remembered, not kept.
    void setTopLevel(RCShdPtr<UiTopLevel> const& window);

    /// Forgets the window told last that still lives.
    void releaseTopLevel();

private:
    /// Told and not yet released, the latest last.
    std::vector<std::weak_ptr<UiTopLevel>> _told;
};

} // namespace Kv
