#pragma once

#include "kvExport.h"
#include "pointers/rcShdPtr.h"
#include "pointers/rcWeakPtr.h"

#include <string>
#include <utility>
#include <vector>

namespace Kv
{

class PiGraph;
class PiNode;

/// The object behind a node, which decides about it. It is held by strong pointers alone, and reached by weak ones.
class KV_API PiNodeController
{
public:
    PiNodeController() = default;
    PiNodeController(PiNodeController const&) = delete;
    PiNodeController& operator=(PiNodeController const&) = delete;
    virtual ~PiNodeController() = default;

    virtual RCShdPtr<const PiNode> getNode() const = 0;
};

/// An operation in a graph. All texts are UTF-8 where nothing else is said.
class KV_API PiNode : public RCBase<LkCounter<int>>
{
public:
    /// Pairs of a name and what stands under it, each name once, in their order.
    using NamedTexts = std::vector<std::pair<std::string, std::string>>;

    /// The graph that the node belongs to; null once that is closed.
    virtual RCShdPtr<const PiGraph> getGraph() const = 0;

    /// Expired once the graph is closed.
    virtual RCWeakPtr<PiNodeController> getController() = 0;

    /// The name that no other node of the graph has.
    virtual std::string const& getName() const = 0;

    virtual std::string const& getType() const = 0;

    /// The names of the nodes that the inputs refer to, by the inputs' names.
    virtual NamedTexts const& getInputs() const = 0;

    /// The values by their names.
    virtual NamedTexts const& getValues() const = 0;
};

/// Nodes that are joined by their inputs. It can outlive its controller; then it is closed, and no longer changes.
class KV_API PiGraph : public RCBase<LkCounter<int>>
{
public:
    /// The controller of the graph as a whole; expired once the graph is closed.
    virtual RCWeakPtr<const PiNodeController> getController() const = 0;
    virtual RCWeakPtr<PiNodeController> getController() = 0;

    /// The name by which users know the graph: bytes, if it comes from a file's name.
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
