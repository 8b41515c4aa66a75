#include <boost/python.hpp>

#include "pyGraph.h"

#include "text/liString.h"
#include "wsThread.h"

#include <functional>

namespace bp = boost::python;

namespace Kv::PyextGraph
{

namespace
{

/// Runs `action`. To a script, its failures are failures of the module.
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

bp::dict toDict(PiNode::NamedTexts const& texts)
{
    bp::dict result;
    for (auto const& text : texts)
        result[text.first] = text.second;
    return result;
}

} // namespace

GraphRO::GraphRO(RCShdPtr<const PiGraph> const& graph) : _graph(graph)
{
    if (graph.isNull())
        RCExUtil::throwExNullPtr(typeid(PiGraph const*).name());
}

GraphRO::~GraphRO() = default;

RCShdPtr<const PiGraph> GraphRO::getPiGraphRO() const
{
    return _graph;
}

OsFilePath GraphRO::getName() const
{
    requireComposition();
    return OsFilePath(_graph->getName());
}

OsFilePath GraphRO::getPath() const
{
    return requireComposition()->getPath();
}

bp::list GraphRO::getNodes() const
{
    requireComposition();
    bp::list names;
    for (RCShdPtr<const PiNode> const& node : _graph->getNodes())
        names.append(node->getName());
    return names;
}

std::string GraphRO::getNodeType(std::string const& nodeName) const
{
    return requireNode(nodeName)->getType();
}

bp::dict GraphRO::getNodeInputs(std::string const& nodeName) const
{
    return toDict(requireNode(nodeName)->getInputs());
}

bp::dict GraphRO::getNodeValues(std::string const& nodeName) const
{
    return toDict(requireNode(nodeName)->getValues());
}

bool GraphRO::isSameGraph(GraphRO const& other) const
{
    return _graph == other._graph;
}

std::size_t GraphRO::getHash() const
{
    return std::hash<PiGraph const*>()(_graph.get());
}

GraphRO::Composition GraphRO::findComposition() const
{
    RCWeakAccessor<const PiNodeController> const controller(_graph->getController());
    return Composition(controller.isNull() ? RCWeakPtr<const PiCompositionGraphInterface>()
                                           : controller.castTo<const PiCompositionGraphInterface>());
}

GraphRO::Composition GraphRO::requireComposition() const
{
    // Those who show the composition hear of a change on the thread that makes it.
    runForScript([] { WsThread::require("Graph"); });
    Composition composition = findComposition();
    if (composition.isNull())
        refuse("has been closed.");
    return composition;
}

void GraphRO::refuse(std::string const& why) const
{
    throw GraphError(__FILE__, __LINE__,
                     ("The composition " + LiStringUtil::getPrintable(_graph->getName()) + " " + why).c_str());
}

RCShdPtr<const PiNode> GraphRO::requireNode(std::string const& name) const
{
    requireComposition();
    RCShdPtr<const PiNode> node = _graph->findNode(name);
    if (node.isNull())
        refuse("has no node " + LiStringUtil::getPrintable(name) + ".");
    return node;
}

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
        refuse("is read-only: its file could not be written when this Graph was handed out.");
    return *_writableGraph;
}

} // namespace Kv::PyextGraph

namespace Kv
{

template class PyextInit::ModError<PyextGraph::GraphModule>;
template class PyManagedObject<RCShdPtr<PyextGraph::Graph>>;

} // namespace Kv
