#pragma once

#include "base/kvExport.h"
#include "base/rcWeakPtr.h"
#include "internalAPI/piCompositionGraphInterface.h"

namespace Kv
{

/// Hears what happens in a workspace, each time after it has happened.
class KV_API UiCompositionWorkspaceListener
{
public:
    UiCompositionWorkspaceListener() = default;
    UiCompositionWorkspaceListener(UiCompositionWorkspaceListener const&) = delete;
    UiCompositionWorkspaceListener& operator=(UiCompositionWorkspaceListener const&) = delete;
    virtual ~UiCompositionWorkspaceListener();

    /// The composition is now the last of the list.
    virtual void compositionOpened(RCWeakPtr<const PiCompositionGraphInterface> const& composition) = 0;

    /// The composition is no longer in the list, and goes when the call is over.
    virtual void compositionClosed(RCWeakPtr<const PiCompositionGraphInterface> const& composition) = 0;

    /// Another composition is the current one, or none is.
    virtual void currentCompositionChanged() = 0;

    /// The composition has been edited or saved.
    virtual void compositionChanged(RCWeakPtr<const PiCompositionGraphInterface> const& composition) = 0;
};

} // namespace Kv
