#include "framework/fwComposition.h"

#include "framework/fwCompositionFormat.h"
#include "framework/fwCompositionListener.h"
#include "framework/fwCompositionReader.h"
#include "framework/fwCompositionWriter.h"
#include "framework/fwGraph.h"
#include "framework/fwNode.h"
#include "resmgt/osFile.h"

#include <utility>

namespace Kv
{

namespace
{

/// The name of the file, without the extension of compositions.
std::string getCompositionName(OsFilePath const& path)
{
    std::string const name = path.getFileName();
    std::string const ending = std::string(".") + FwComposition::extension;
    bool const isMore = name.size() > ending.size();
    return isMore && name.compare(name.size() - ending.size(), ending.size(), ending) == 0
               ? name.substr(0, name.size() - ending.size())
               : name;
}

} // namespace

RCStrongPtr<FwComposition> FwComposition::open(OsFilePath const& path)
{
    OsFilePath const canonical = path.getCanonical();
    std::vector<FwNode::Description> nodes = FwCompositionReader::read(canonical);
    RCStrongPtr<FwComposition> composition(std::shared_ptr<FwComposition>(new FwComposition(canonical)));
    std::string const name = getCompositionName(canonical);
    composition->_node =
        makeShd<FwNode>(composition, FwNode::Description{name, FwCompositionFormat::composition, {}, {}});
    composition->_graph = makeShd<FwGraph>(composition, name, std::move(nodes));
    return composition;
}

FwComposition::FwComposition(OsFilePath path) : _path(std::move(path)) {}

FwComposition::~FwComposition() = default;

RCShdPtr<const PiNode> FwComposition::getNode() const
{
    return _node;
}

RCShdPtr<const PiGraph> FwComposition::getGraph() const
{
    return _graph;
}

RCShdPtr<PiGraph> FwComposition::getGraph()
{
    return _graph;
}

OsFilePath const& FwComposition::getPath() const
{
    return _path;
}

bool FwComposition::isEditable() const
{
    return OsFile(_path).isWritable();
}

bool FwComposition::isModified() const
{
    return _isModified;
}

void FwComposition::save()
{
    OsFile(_path).replace(FwCompositionWriter::write(*_graph));
    _isModified = false;
    if (_listener)
        _listener->compositionSaved(*this);
}

void FwComposition::setListener(FwCompositionListener* listener)
{
    _listener = listener;
}

void FwComposition::noteChange()
{
    _isModified = true;
    if (_listener)
        _listener->compositionChanged(*this);
}

} // namespace Kv
