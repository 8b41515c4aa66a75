#pragma once

#include "kvExport.h"
#include "pointers/rcShdPtr.h"
#include "pointers/uPtr.h"
#include "uiWidget.h"

namespace Kv
{

/// Where the user of the interactive application works.
class KV_API UiWorkspace : public RCBase<LkCounter<int>>
{
public:
    ~UiWorkspace() override;

    /// Null where there is no interactive application. Throws an `ExBase` on any other thread than that of the user
    /// interface.
    static RCShdPtr<UiWorkspace> getCurrentWorkspace();

    /// For the application: null when it ends.
    static void setCurrentWorkspace(RCShdPtr<UiWorkspace> const& workspace);

    /// The widget that has the keyboard, borrowed; the browser where it is a button beside one; null if none has.
    virtual UPtr<UiWidget> getFocus() const = 0;
};

} // namespace Kv
