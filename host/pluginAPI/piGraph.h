#pragma once

#include "kvExport.h"
#include "pointers/rcShdPtr.h"
#include "pointers/rcWeakPtr.h"

#include <string>
#include <vector>

namespace Kv
{

class PiNode;
class PiNodeController;

/// Nodes that are joined by their inputs. It can outlive its controller; then it is closed, and no longer changes.
class KV_API PiGraph : public RCBase<LkCounter<int>>
{
public:
    ~PiGraph() override;

    /// What controls the graph as a whole; expired once the graph is closed.
    virtual RCWeakPtr<const PiNodeController> getController() const = 0;
    virtual RCWeakPtr<PiNodeController> getController() = 0;

    /// What users know the graph by: bytes, if it comes from a file's name.
    virtual std::string const& getName() const = 0;

    /// All nodes, in their order.
    virtual std::vector<RCShdPtr<const PiNode>> getNodes() const = 0;

    /// Null where there is no node of that name.
    virtual RCShdPtr<const PiNode> findNode(std::string const& name) const = 0;

    /// Sets a value of a node, or adds it behind the others. Throws `ExBase` and changes nothing for a node that is not
    /// there, for texts that cannot be stored, and for a graph that is closed or cannot be edited.
    virtual void setNodeValue(std::string const& nodeName, std::string const& valueName, std::string const& text) = 0;
};

} // namespace Kv
