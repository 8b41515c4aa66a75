// The file of a composition: opened, changed, saved and opened again. What is no composition is refused in words, and
// what is one returns as it was.

#include "fuzz.h"

#include "exBase.h"
#include "fwComposition.h"
#include "piGraph.h"

#include <algorithm>

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

/// Writes the bytes into a value of the first node. Where they cannot be a value's text, nothing changes.
void change(FwComposition& composition, std::string const& text)
{
    auto const nodes = composition.getGraph()->getNodes();
    if (nodes.empty())
        return;
    PiNode const& node = *nodes.front();
    auto const before = node.getValues();
    try
    {
        composition.getGraph()->setNodeValue(node.getName(), "text", text);
    }
    catch (ExBase const&)
    {
        Fuzz::require(node.getValues() == before, "a refusal changes nothing");
        return;
    }
    auto const values = node.getValues();
    bool const isThere =
        std::any_of(values.begin(), values.end(),
                    [&text](auto const& value) { return value.first == "text" && value.second == text; });
    Fuzz::require(isThere, "a value is what was written");
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
