#pragma once

#include "files/osFile.h"
#include "files/osFilePath.h"
#include "fwNode.h"
#include "kvExport.h"
#include "piCompositionGraphInterface.h"
#include "pointers/rcWeakPtr.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace Kv
{

class FwGraph;

/// A composition that has been read from its file. It has one owner, and is closed by that letting it go; what is left
/// of its graph then no longer changes.
class KV_API FwComposition : public PiCompositionGraphInterface
{
public:
    /// The extension of the names of compositions' files, with the dot.
    static constexpr char const* extension = ".vmcomposition";

    /// Reads the file, whatever its extension. Throws `ExBase`, naming the file and the line, for what is wrong with
    /// it.
    static RCStrongPtr<FwComposition> open(OsFilePath const& path);

    /// Owns a composition until a workspace takes it over, and is empty from then on.
    using Keeper = std::shared_ptr<RCStrongPtr<FwComposition>>;

    /// Reads the file as `open` does, for somebody who is no workspace.
    static Keeper openApart(OsFilePath const& path);

    /// Makes a composition with changes that are not saved, without a look at its file. Throws `ExBase`, naming the
    /// line of the text, for what is wrong with that.
    static Keeper restoreApart(PiUnsavedComposition const& unsaved);

    ~FwComposition() override;

    /// True while a keeper owns it.
    bool isApart() const;

    /// Takes it from its keeper. Null where none owns it.
    RCStrongPtr<FwComposition> takeOver() const;

    /// The node that stands for the composition as a whole, and is none of the nodes of its graph.
    RCShdPtr<const PiNode> getNode() const override;

    RCShdPtr<const PiGraph> getGraph() const override;
    RCShdPtr<PiGraph> getGraph() override;
    OsFilePath const& getPath() const override;
    bool isEditable() const override;
    bool isModified() const override;
    std::uint64_t getChangeCount() const override;
    PiUnsavedComposition getUnsaved() const override;
    bool isChangedOnDisk() const override;
    void save() override;
    void saveOver() override;

    /// Called when the composition has been changed or saved; null for none. Takes the place of the one before.
    void setChangeCallback(std::function<void()> callback);

private:
    friend class FwGraph;

    FwComposition(OsFilePath path, OsFile::Version const& version);

    /// `path` is canonical.
    static RCStrongPtr<FwComposition> make(OsFilePath const& path, OsFile::Version const& version,
                                           std::vector<FwNode::Description> nodes);
    static Keeper keepApart(RCStrongPtr<FwComposition> const& composition);

    /// Throws `ExBase` where the system cannot tell.
    bool hasOtherVersion() const;

    void setModified(bool isModified);

    OsFilePath _path;
    /// That of the file as it was read or written last.
    OsFile::Version _version{};
    RCShdPtr<FwNode> _node;
    RCShdPtr<FwGraph> _graph;
    bool _isModified = false;
    std::uint64_t _changeCount = 0;
    Keeper::weak_type _keeper;
    std::function<void()> _changeCallback;
};

} // namespace Kv
