#pragma once

#include "base/kvExport.h"
#include "base/rcStrongPtr.h"
#include "base/rcWeakPtr.h"
#include "internalAPI/piCompositionGraphInterface.h"
#include "resmgt/osFilePath.h"

#include <functional>

namespace Kv
{

class FwGraph;
class FwNode;

/// A composition that has been read from its file. It is closed by its strong pointers being let go; what is left of
/// its graph then no longer changes.
class KV_API FwComposition : public PiCompositionGraphInterface
{
public:
    /// The extension of the names of compositions' files, with the dot.
    static constexpr char const* extension = ".vmcomposition";

    /// Reads the file, whatever its extension. Throws `ExBase`, naming the file and the line, for what is wrong with
    /// it.
    static RCStrongPtr<FwComposition> open(OsFilePath const& path);

    ~FwComposition() override;

    /// The node that stands for the composition as a whole, and is none of the nodes of its graph.
    RCShdPtr<const PiNode> getNode() const override;

    RCShdPtr<const PiGraph> getGraph() const override;
    RCShdPtr<PiGraph> getGraph() override;
    OsFilePath const& getPath() const override;
    bool isEditable() const override;
    bool isModified() const override;
    bool isChangedOnDisk() const override;
    void save() override;
    void saveOver() override;

    /// Called when the composition has been changed or saved; null for none. Takes the place of the one before.
    void setChangeCallback(std::function<void()> callback);

private:
    friend class FwGraph;

    explicit FwComposition(OsFilePath path);

    void setModified(bool isModified);

    OsFilePath _path;
    /// That of the file as it was read or written last.
    std::string _version;
    RCShdPtr<FwNode> _node;
    RCShdPtr<FwGraph> _graph;
    bool _isModified = false;
    std::function<void()> _changeCallback;
};

} // namespace Kv
