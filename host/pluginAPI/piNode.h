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
class PiNodeController;

/// An operation in a graph. All texts are UTF-8 where nothing else is said.
class KV_API PiNode : public RCBase<LkCounter<int>>
{
public:
    /// Pairs of a name and what stands under it, each name once, in their order.
    using NamedTexts = std::vector<std::pair<std::string, std::string>>;

    ~PiNode() override;

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

} // namespace Kv
