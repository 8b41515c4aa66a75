#include <boost/python.hpp>

#include "pyGraph.h"

#include "pyGraphError.h"
#include "pyManagedGraph.h"
#include "text/liString.h"
#include "wsThread.h"

namespace bp = boost::python;

namespace Kv::PyextGraph
{

namespace
{

/// To a script, what the graph refuses is no other failure than what the module itself refuses.
template <typename Action> auto runForScript(Action const& action)
{
    try
    {
        return action();
    }
    catch (ExBase const& failure)
    {
        throw GraphError(__FILE__, __LINE__, failure.getReason());
    }
}

} // namespace

Graph::Graph(RCShdPtr<PiGraph> const& graph) : GraphRO(graph), _writableGraph(graph) {}

Graph::Graph(RCShdPtr<const PiGraph> const& graph) : GraphRO(graph) {}

RCShdPtr<Graph> Graph::read(OsFilePath const& path)
{
    FwComposition::Keeper const keeper = runForScript(
        [&path]
        {
            WsThread::require("Graph");
            return FwComposition::openApart(path);
        });
    RCShdPtr<PiGraph> const piGraph = (*keeper)->getGraph();
    RCShdPtr<Graph> graph =
        (*keeper)->isEditable() ? makeShd<Graph>(piGraph) : makeShd<Graph>(RCShdPtr<const PiGraph>(piGraph));
    graph->_keeper = keeper;
    return graph;
}

Graph::~Graph() = default;

bool Graph::isWritable() const
{
    bool const isEditable = requireComposition()->isEditable();
    return !_writableGraph.isNull() && isEditable;
}

void Graph::setNodeValue(std::string const& nodeName, std::string const& key, std::string const& value)
{
    PiGraph& graph = requireWritable();
    runForScript([&] { graph.setNodeValue(nodeName, key, value); });
}

void Graph::save()
{
    RCWeakAccessor<PiNodeController> const controller(requireWritable().getController());
    RCWeakAccessor<PiCompositionGraphInterface> const composition(controller.castTo<PiCompositionGraphInterface>());
    runForScript([&composition] { composition->save(); });
}

bp::object Graph::describe() const
{
    Composition const composition = findComposition();
    bp::object const name(OsFilePath(getPiGraphRO()->getName()));
    if (composition.isNull())
        return bp::str("<Graph %r, closed>") % bp::make_tuple(name);
    char const* const format = _writableGraph.isNull() ? "<Graph %r of %r, read-only>" : "<Graph %r of %r>";
    return bp::str(format) % bp::make_tuple(name, composition->getPath());
}

PiGraph& Graph::requireWritable() const
{
    requireComposition();
    if (_writableGraph.isNull())
        throw GraphError(__FILE__, __LINE__,
                         ("The composition " + LiStringUtil::getPrintable(getPiGraphRO()->getName()) +
                          " is read-only: its file could not be written when this Graph was handed out.")
                             .c_str());
    return *_writableGraph;
}

} // namespace Kv::PyextGraph

namespace Kv
{

template class PyManagedObject<RCShdPtr<PyextGraph::Graph>>;

} // namespace Kv
