#pragma once

#include "kvExport.h"
#include "pointers/plainPtr.h"
#include "pointers/rcBase.h"
#include "pointers/rcShdPtr.h"
#include "snSelection.h"
#include "uiWidget.h"

namespace Kv
{

/// The view of a widget that shows a collection: others learn from it what is selected. It is found among the widget's
/// client data.
class KV_API UiView : public RCBase<LkCounter<int>>
{
public:
    ~UiView() override;

    /// The selection in it now; null where it has none at all, as when its widget is gone.
    virtual RCShdPtr<SnSelection> getSelection() = 0;
};

/// The place where the user of the interactive application works.
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
