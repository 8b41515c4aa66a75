#pragma once

#include <boost/python/dict.hpp>
#include <boost/python/list.hpp>

#include "files/osFilePath.h"
#include "kvExport.h"
#include "piCompositionGraphInterface.h"
#include "piGraph.h"
#include "pointers/rcShdPtr.h"
#include "pointers/rcWeakPtr.h"

#include <string>

namespace Kv::PyextGraph
{

/// What a script can read of a composition. It keeps the graph, but not the composition: once that is closed, whatever
/// asks for it throws `GraphError`.
class KV_API GraphRO : public RCBase<LkCounter<int>>
{
public:
    /// `graph` is that of a composition; null throws `ExNullPtr`.
    explicit GraphRO(RCShdPtr<const PiGraph> const& graph);
    ~GraphRO() override;

    RCShdPtr<const PiGraph> getPiGraphRO() const;

    /// The name of the composition: that of its file without the extension. Like the path, it is bytes of the file
    /// system.
    OsFilePath getName() const;

    OsFilePath getPath() const;

    /// The names of all nodes, in their order.
    boost::python::list getNodes() const;

    // Each throws `GraphError` where there is no node of that name.
    std::string getNodeType(std::string const& nodeName) const;
    boost::python::dict getNodeInputs(std::string const& nodeName) const;
    boost::python::dict getNodeValues(std::string const& nodeName) const;

    /// Whether two objects stand for one graph.
    bool isSameGraph(GraphRO const& other) const;

    std::size_t getHash() const;

protected:
    using Composition = RCWeakAccessor<const PiCompositionGraphInterface>;

    /// Empty once it has been closed.
    Composition findComposition() const;

    /// Throws `GraphError` where it has been closed.
    Composition requireComposition() const;

private:
    RCShdPtr<const PiNode> requireNode(std::string const& name) const;

    RCShdPtr<const PiGraph> _graph;
};

} // namespace Kv::PyextGraph
