#pragma once

#include <boost/python/dict.hpp>
#include <boost/python/list.hpp>

#include "files/osFilePath.h"
#include "fwComposition.h"
#include "kvExport.h"
#include "piCompositionGraphInterface.h"
#include "piGraph.h"
#include "pointers/rcShdPtr.h"
#include "pointers/rcWeakPtr.h"
#include "pyManagedObject.h"
#include "pyModError.h"

#include <string>

namespace Kv::PyextGraph
{

/// Stands for this module where a template asks which one.
class KV_API GraphModule;

/// The module's own failures. Scripts see them as `GraphError`.
using GraphError = PyextInit::ModError<GraphModule>;

/// The reading part of a composition as a script has it. It keeps the graph, but not the composition. Once that is
/// closed, each operation that needs it throws `GraphError`.
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

    /// True where two objects stand for one graph.
    bool isSameGraph(GraphRO const& other) const;

    std::size_t getHash() const;

protected:
    using Composition = RCWeakAccessor<const PiCompositionGraphInterface>;

    /// Empty once it has been closed.
    Composition findComposition() const;

    /// Throws `GraphError` where it has been closed.
    Composition requireComposition() const;

    /// Throws `GraphError`, which begins with the composition's name.
    [[noreturn]] void refuse(std::string const& why) const;

private:
    RCShdPtr<const PiNode> requireNode(std::string const& name) const;

    RCShdPtr<const PiGraph> _graph;
};

/// A composition as a script has it: to be read, and if it was made writable, to be changed.
class KV_API Graph : public GraphRO
{
public:
    /// Writable.
    explicit Graph(RCShdPtr<PiGraph> const& graph);

    /// Read-only.
    explicit Graph(RCShdPtr<const PiGraph> const& graph);

    /// Reads the file of a composition, which is writable if the file can be written now. Until a workspace opens it,
    /// it is open for as long as the result. Throws `GraphError` for a fault of the file.
    static RCShdPtr<Graph> read(OsFilePath const& path);

    ~Graph() override;

    /// True where this object was made writable and the composition's file can be written now.
    bool isWritable() const;

    /// Sets a value of a node, or adds it. Throws `GraphError` and changes nothing where this object is read-only, the
    /// file cannot be written now, there is no such node, or the texts cannot be stored.
    void setNodeValue(std::string const& nodeName, std::string const& key, std::string const& value);

    /// Writes the composition's file. Throws `GraphError` where this object is read-only or the file cannot be written,
    /// which leaves the file as it was.
    void save();

    /// The text of `repr`: name and path, with a mark where it is read-only or closed.
    boost::python::object describe() const;

private:
    /// Throws `GraphError` where the composition has been closed, or this object is read-only.
    PiGraph& requireWritable() const;

    /// Null if read-only.
    RCShdPtr<PiGraph> _writableGraph;
    /// Null for a composition of a workspace.
    FwComposition::Keeper _keeper;
};

} // namespace Kv::PyextGraph

namespace Kv
{

/// The wrapper that Python objects keep of a graph.
using ManagedGraph = PyManagedObject<RCShdPtr<PyextGraph::Graph>>;

// One set of statics and type records for all libraries.
extern template class KV_API PyextInit::ModError<PyextGraph::GraphModule>;
extern template class KV_API PyManagedObject<RCShdPtr<PyextGraph::Graph>>;

} // namespace Kv
