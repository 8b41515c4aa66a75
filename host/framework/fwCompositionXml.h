#pragma once

#include "files/osFilePath.h"
#include "fwNode.h"
#include "piGraph.h"
#include "xml/xmlElement.h"

#include <set>
#include <string>
#include <vector>

namespace Kv
{

/// Reads the file of a composition, of which it takes nothing that it does not know.
class FwCompositionReader
{
public:
    /// The nodes in their order. Throws `ExBase`, naming the file and the line, for whatever is wrong with it.
    static std::vector<FwNode::Description> read(OsFilePath const& path);

    /// The same for the content of a file. The words name the line alone.
    static std::vector<FwNode::Description> parse(std::string const& text);

private:
    struct Reference
    {
        int line;
        std::string inputName;
        std::string nodeName;
    };

    explicit FwCompositionReader(std::string const& text);

    void readNode(XmlElement const& element);
    void requireReferencedNodes() const;

    std::vector<FwNode::Description> _nodes;
    std::set<std::string> _names;
    /// An input can refer to a node further down.
    std::vector<Reference> _references;
};

/// Writes compositions as `FwCompositionReader` reads them.
class FwCompositionWriter
{
public:
    /// The text of the whole file, which gives exactly the same nodes when it is read.
    static std::string write(PiGraph const& graph);
};

} // namespace Kv
