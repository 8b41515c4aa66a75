#include <boost/python.hpp>

#include "pyGraphRo.h"

#include "pyGraphError.h"
#include "text/liString.h"
#include "wsThread.h"

#include <functional>

namespace bp = boost::python;

namespace Kv::PyextGraph
{

namespace
{

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
    try
    {
        // Whoever shows the composition hears of changes on the thread that they come on.
        WsThread::require("Graph");
    }
    catch (ExBase const& failure)
    {
        throw GraphError(__FILE__, __LINE__, failure.getReason());
    }
    Composition composition = findComposition();
    if (composition.isNull())
        throw GraphError(
            __FILE__, __LINE__,
            ("The composition " + LiStringUtil::getPrintable(_graph->getName()) + " has been closed.").c_str());
    return composition;
}

RCShdPtr<const PiNode> GraphRO::requireNode(std::string const& name) const
{
    requireComposition();
    RCShdPtr<const PiNode> node = _graph->findNode(name);
    if (node.isNull())
        throw GraphError(__FILE__, __LINE__,
                         ("The composition " + LiStringUtil::getPrintable(_graph->getName()) + " has no node " +
                          LiStringUtil::getPrintable(name) + ".")
                             .c_str());
    return node;
}

} // namespace Kv::PyextGraph
