#pragma once

#include "files/osFilePath.h"
#include "iterators/constIterator.h"
#include "kvExport.h"
#include "piCompositionGraphInterface.h"
#include "piGraph.h"
#include "pointers/rcShdPtr.h"
#include "pointers/rcWeakPtr.h"

namespace Kv
{

/// The compositions of a workspace, for whoever is not the application. They are watched, not held: one that is closed
/// expires.
class KV_API UiCompositionWorkspaceClientInterface
{
public:
    UiCompositionWorkspaceClientInterface() = default;
    UiCompositionWorkspaceClientInterface(UiCompositionWorkspaceClientInterface const&) = delete;
    UiCompositionWorkspaceClientInterface& operator=(UiCompositionWorkspaceClientInterface const&) = delete;
    virtual ~UiCompositionWorkspaceClientInterface();

    /// Expired when there is none.
    virtual RCWeakPtr<const PiCompositionGraphInterface> getCurrentComposition() const = 0;

    /// Makes the composition the current one. One that a script has read belongs to the workspace from then on; where
    /// its file is open already, the script keeps it, and the one that is open is made the current one. Throws `ExBase`
    /// for a composition that has been closed. So it does where the file is open already and the script has changes
    /// that are not saved.
    virtual void openComposition(RCWeakPtr<const PiCompositionGraphInterface> const& composition) = 0;

    /// The composition that the graph belongs to, open here or read by a script; expired if it has been closed.
    virtual RCWeakPtr<const PiCompositionGraphInterface> getComposition(RCShdPtr<const PiGraph> const& graph) const = 0;

    /// Whether the composition is open and can be changed now, which the disk decides.
    virtual bool isCompositionEditable(RCWeakPtr<const PiCompositionGraphInterface> const& composition) const = 0;

    /// Whether the file is that of an open composition, by whatever path it is named, and also if it was deleted since.
    virtual bool isCompositionOpened(OsFilePath const& path) const = 0;

    virtual unsigned int getNbCompositions() const = 0;

    /// All of them, in the order in which they were opened.
    virtual ConstIterator<RCWeakPtr<const PiCompositionGraphInterface>> getCompositions() const = 0;
};

} // namespace Kv
