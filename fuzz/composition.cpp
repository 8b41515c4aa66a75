// The file of a composition: opened, changed, saved and opened again. What is no composition is refused in words, and
// what is one returns as it was.

#include "fuzz.h"

#include "exBase.h"
#include "fwComposition.h"
#include "piGraph.h"

#include <optional>

using namespace Kv;

namespace
{

void requireSame(PiGraph const& a, PiGraph const& b)
{
    auto const left = a.getNodes();
    auto const right = b.getNodes();
    Fuzz::require(left.size() == right.size(), "as many nodes return");
    for (std::size_t index = 0; index < left.size(); ++index)
    {
        Fuzz::require(left[index]->getName() == right[index]->getName(), "a node's name returns");
        Fuzz::require(left[index]->getType() == right[index]->getType(), "a node's type returns");
        Fuzz::require(left[index]->getInputs() == right[index]->getInputs(), "a node's inputs return");
        Fuzz::require(left[index]->getValues() == right[index]->getValues(), "a node's values return");
    }
}

/// Writes the bytes into a value of the first node. False where they cannot be a value's text, and nothing changed.
bool change(FwComposition& composition, std::string const& text)
{
    auto const nodes = composition.getGraph()->getNodes();
    if (nodes.empty())
        return false;
    try
    {
        composition.getGraph()->setNodeValue(nodes.front()->getName(), "text", text);
        return true;
    }
    catch (ExBase const&)
    {
        return false;
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    static Fuzz::Folder const folder;
    OsFilePath const path(folder.write("input.vmcomposition", Fuzz::asText(data, size)).string());
    RCStrongPtr<FwComposition> composition;
    try
    {
        composition = FwComposition::open(path);
    }
    catch (ExBase const& error)
    {
        Fuzz::require(std::string_view(error.getReason()).find("input") != std::string_view::npos,
                      "an error names the file");
        return 0;
    }
    change(*composition, std::string(Fuzz::asText(data, size).substr(0, 64)));
    composition->save();
    requireSame(*composition->getGraph(), *FwComposition::open(path)->getGraph());
    return 0;
}
