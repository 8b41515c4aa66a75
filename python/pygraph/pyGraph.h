#pragma once

#include "fwComposition.h"
#include "pyGraphRo.h"

#include <string>

namespace Kv::PyextGraph
{

/// A composition as a script has it: to be read, and if it was made writable, to be changed.
class KV_API Graph : public GraphRO
{
public:
    /// Writable.
    explicit Graph(RCShdPtr<PiGraph> const& graph);

    /// Read-only.
    explicit Graph(RCShdPtr<const PiGraph> const& graph);

    /// Reads the file of a composition, which is writable if the file can be written now. Until a workspace opens it,
    /// it is open for as long as the result. Throws `GraphError` for what is wrong with the file.
    static RCShdPtr<Graph> read(OsFilePath const& path);

    ~Graph() override;

    /// Whether this object was made writable, and the composition's file can be written now.
    bool isWritable() const;

    /// Sets a value of a node, or adds it. Throws `GraphError` and changes nothing where this object is read-only, the
    /// file cannot be written now, there is no such node, or the texts cannot be stored.
    void setNodeValue(std::string const& nodeName, std::string const& key, std::string const& value);

    /// Writes the composition's file. Throws `GraphError` where this object is read-only or the file cannot be written,
    /// which leaves the file as it was.
    void save();

    /// What `repr` shows: name, path, and whether it can be changed, or that it is closed.
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
