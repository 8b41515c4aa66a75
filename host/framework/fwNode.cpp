#include "fwNode.h"

#include "fwComposition.h"
#include "pointers/rcWeakPtr.h"

#include <algorithm>
#include <utility>

namespace Kv
{

FwNode::FwNode(RCWeakPtr<FwComposition> const& composition, Description description)
    : _composition(composition), _description(std::move(description))
{
}

RCShdPtr<const PiGraph> FwNode::getGraph() const
{
    RCWeakAccessor<const FwComposition> const composition(_composition);
    return composition.isNull() ? nullptr : composition->getGraph();
}

RCWeakPtr<PiNodeController> FwNode::getController()
{
    return _composition;
}

std::string const& FwNode::getName() const
{
    return _description.name;
}

std::string const& FwNode::getType() const
{
    return _description.type;
}

PiNode::NamedTexts const& FwNode::getInputs() const
{
    return _description.inputs;
}

PiNode::NamedTexts const& FwNode::getValues() const
{
    return _description.values;
}

bool FwNode::setValue(std::string const& name, std::string const& text)
{
    NamedTexts& values = _description.values;
    auto const known =
        std::find_if(values.begin(), values.end(), [&name](auto const& value) { return value.first == name; });
    if (known == values.end())
        values.emplace_back(name, text);
    else if (known->second == text)
        return false;
    else
        known->second = text;
    return true;
}

} // namespace Kv
