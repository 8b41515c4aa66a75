#pragma once

#include "piGraph.h"
#include "pointers/rcWeakPtr.h"

#include <string>

namespace Kv
{

class FwComposition;

/// A node of a composition. It can outlive the composition, and keeps what it says then.
class FwNode : public PiNode
{
public:
    /// The name, type, inputs and values of a node, as its file gives them.
    struct Description
    {
        std::string name;
        std::string type;
        NamedTexts inputs;
        NamedTexts values;
    };

    FwNode(RCWeakPtr<FwComposition> const& composition, Description description);

    RCShdPtr<const PiGraph> getGraph() const override;
    RCWeakPtr<PiNodeController> getController() override;
    std::string const& getName() const override;
    std::string const& getType() const override;
    NamedTexts const& getInputs() const override;
    NamedTexts const& getValues() const override;

    /// Sets a value or adds it behind the others. True if that is a change.
    bool setValue(std::string const& name, std::string const& text);

private:
    RCWeakPtr<FwComposition> _composition;
    Description _description;
};

} // namespace Kv
