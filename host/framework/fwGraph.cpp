#include "fwGraph.h"

#include "fwComposition.h"
#include "pointers/rcWeakPtr.h"
#include "text/liString.h"
#include "xml/xmlWriter.h"

#include <utility>

namespace Kv
{

namespace
{

[[noreturn]] void fail(std::string const& words)
{
    throw ExBase(__FILE__, __LINE__, words);
}

} // namespace

FwGraph::FwGraph(RCWeakPtr<FwComposition> const& composition, std::string name, std::vector<FwNode::Description> nodes)
    : _composition(composition), _name(std::move(name))
{
    for (FwNode::Description& description : nodes)
    {
        RCShdPtr<FwNode> const node = makeShd<FwNode>(composition, std::move(description));
        _nodes.push_back(node);
        _nodesByName.emplace(node->getName(), node);
    }
}

RCWeakPtr<const PiNodeController> FwGraph::getController() const
{
    return _composition;
}

RCWeakPtr<PiNodeController> FwGraph::getController()
{
    return _composition;
}

std::string const& FwGraph::getName() const
{
    return _name;
}

std::vector<RCShdPtr<const PiNode>> FwGraph::getNodes() const
{
    return {_nodes.begin(), _nodes.end()};
}

RCShdPtr<const PiNode> FwGraph::findNode(std::string const& name) const
{
    auto const node = _nodesByName.find(name);
    return node == _nodesByName.end() ? nullptr : node->second;
}

void FwGraph::setNodeValue(std::string const& nodeName, std::string const& valueName, std::string const& text)
{
    RCWeakAccessor<FwComposition> const composition(_composition);
    if (composition.isNull())
        fail("Composition " + LiStringUtil::getPrintable(_name) + " has been closed");
    auto const node = _nodesByName.find(nodeName);
    if (node == _nodesByName.end())
        fail("Composition " + LiStringUtil::getPrintable(_name) + " has no node " +
             LiStringUtil::getPrintable(nodeName));
    if (!composition->isEditable())
        fail("Composition " + LiStringUtil::getPrintable(_name) + " cannot be changed: " +
             LiStringUtil::getPrintablePath(composition->getPath().toString()) + " cannot be written");
    if (valueName.empty())
        fail("A value needs a name");
    XmlWriter::requireText(valueName, "name of a value");
    XmlWriter::requireText(text, "value " + LiStringUtil::getPrintable(valueName));
    if (node->second->setValue(valueName, text))
        composition->setModified(true);
}

} // namespace Kv
