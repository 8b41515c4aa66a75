#pragma once

#include "fwNode.h"
#include "piGraph.h"
#include "pointers/rcWeakPtr.h"

#include <map>
#include <string>
#include <vector>

namespace Kv
{

class FwComposition;

/// The graph of a composition. It can outlive the composition, and keeps its nodes then.
class FwGraph : public PiGraph
{
public:
    /// Each of `nodes` has a name of its own.
    FwGraph(RCWeakPtr<FwComposition> const& composition, std::string name, std::vector<FwNode::Description> nodes);

    RCWeakPtr<const PiNodeController> getController() const override;
    RCWeakPtr<PiNodeController> getController() override;
    std::string const& getName() const override;
    std::vector<RCShdPtr<const PiNode>> getNodes() const override;
    RCShdPtr<const PiNode> findNode(std::string const& name) const override;
    void setNodeValue(std::string const& nodeName, std::string const& valueName, std::string const& text) override;

private:
    RCWeakPtr<FwComposition> _composition;
    std::string _name;
    std::vector<RCShdPtr<FwNode>> _nodes;
    std::map<std::string, RCShdPtr<FwNode>> _nodesByName;
};

} // namespace Kv
