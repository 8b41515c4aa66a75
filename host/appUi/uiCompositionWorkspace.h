#pragma once

#include "files/osFilePath.h"
#include "iterator.h"
#include "kvExport.h"
#include "piCompositionGraphInterface.h"
#include "piGraph.h"
#include "pointers/rcShdPtr.h"
#include "pointers/rcWeakPtr.h"
#include "uiWorkspace.h"

#include <functional>
#include <vector>

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

    /// True if the composition is open and can be changed now, which the disk decides.
    virtual bool isCompositionEditable(RCWeakPtr<const PiCompositionGraphInterface> const& composition) const = 0;

    /// True if the file is that of an open composition, by whatever path it is named, and also if it was deleted since.
    virtual bool isCompositionOpened(OsFilePath const& path) const = 0;

    virtual unsigned int getNbCompositions() const = 0;

    /// All of them, in the order in which they were opened.
    virtual ConstIterator<RCWeakPtr<const PiCompositionGraphInterface>> getCompositions() const = 0;
};

class FwComposition;

/// The workspace of the application: opens compositions, holds them, and closes them. While there are any, one of them
/// is the current one.
class KV_API UiCompositionWorkspace : public UiWorkspace, public UiCompositionWorkspaceClientInterface
{
public:
    /// Gives the widget that has the keyboard, borrowed, or null.
    using FocusFinder = std::function<UiWidget*()>;

    /// Without a `findFocus` no widget ever has the keyboard.
    explicit UiCompositionWorkspace(FocusFinder findFocus = {});
    UiCompositionWorkspace(UiCompositionWorkspace const&) = delete;
    UiCompositionWorkspace& operator=(UiCompositionWorkspace const&) = delete;
    ~UiCompositionWorkspace() override;

    /// Called once for all that an operation changes: compositions, which of them is current, or what is in one; null
    /// for none. Takes the place of the one before.
    void setChangeCallback(std::function<void()> callback);

    /// Opens the composition of a file, if it is not open already, and makes it the current one. Throws `ExBase`,
    /// naming the file and the line, for what is wrong with it.
    RCWeakPtr<const PiCompositionGraphInterface> open(OsFilePath const& path);

    /// Lets the composition go, with the changes that have not been saved. If it was the current one, the next one in
    /// the list is so now, or else the last. Throws `ExBase` for one that has been closed.
    void close(RCWeakPtr<const PiCompositionGraphInterface> const& composition);

    /// Writes the file of the composition. Throws `ExBase` for one that has been closed, and where it cannot be
    /// written or is changed on disk.
    void save(RCWeakPtr<const PiCompositionGraphInterface> const& composition);

    /// The same, also where the file is changed on disk.
    void saveOver(RCWeakPtr<const PiCompositionGraphInterface> const& composition);

    /// Throws `ExBase` for a composition that has been closed.
    void makeCurrent(RCWeakPtr<const PiCompositionGraphInterface> const& composition);

    UPtr<UiWidget> getFocus() const override;

    RCWeakPtr<const PiCompositionGraphInterface> getCurrentComposition() const override;
    void openComposition(RCWeakPtr<const PiCompositionGraphInterface> const& composition) override;
    RCWeakPtr<const PiCompositionGraphInterface> getComposition(RCShdPtr<const PiGraph> const& graph) const override;
    bool isCompositionEditable(RCWeakPtr<const PiCompositionGraphInterface> const& composition) const override;
    bool isCompositionOpened(OsFilePath const& path) const override;
    unsigned int getNbCompositions() const override;
    ConstIterator<RCWeakPtr<const PiCompositionGraphInterface>> getCompositions() const override;

private:
    using Compositions = std::vector<RCStrongPtr<FwComposition>>;

    Compositions::const_iterator find(OsFilePath const& path) const;
    void add(RCStrongPtr<FwComposition> const& composition);
    RCStrongPtr<FwComposition> require(RCWeakPtr<const PiCompositionGraphInterface> const& composition) const;
    void setCurrent(RCStrongPtr<FwComposition> const& composition);
    void tellChange() const;

    FocusFinder _findFocus;
    std::function<void()> _changeCallback;
    Compositions _compositions;
    /// Null while there are no compositions.
    RCStrongPtr<FwComposition> _current;
};

} // namespace Kv
