#include "fwComposition.h"

#include "fwCompositionXml.h"
#include "fwGraph.h"
#include "fwNode.h"
#include "text/liString.h"

#include <filesystem>
#include <utility>

namespace Kv
{

namespace
{

/// The name of the file, without the extension of compositions.
std::string getCompositionName(OsFilePath const& path)
{
    std::filesystem::path const name = path.getFileName();
    return name.extension() == FwComposition::extension ? name.stem() : name;
}

} // namespace

RCStrongPtr<FwComposition> FwComposition::open(OsFilePath const& path)
{
    OsFilePath const canonical = path.getCanonical();
    // Before it is read: what comes in between counts as a change.
    OsFile::Version const version = OsFile(canonical).getVersion();
    return make(canonical, version, FwCompositionReader::read(canonical));
}

FwComposition::Keeper FwComposition::openApart(OsFilePath const& path)
{
    return keepApart(open(path));
}

FwComposition::Keeper FwComposition::restoreApart(PiUnsavedComposition const& unsaved)
{
    RCStrongPtr<FwComposition> const composition =
        make(unsaved.path, unsaved.version, FwCompositionReader::parse(unsaved.text));
    composition->setModified(true);
    return keepApart(composition);
}

FwComposition::FwComposition(OsFilePath path, OsFile::Version const& version)
    : _path(std::move(path)), _version(version)
{
}

RCStrongPtr<FwComposition> FwComposition::make(OsFilePath const& path, OsFile::Version const& version,
                                               std::vector<FwNode::Description> nodes)
{
    RCStrongPtr<FwComposition> composition(std::shared_ptr<FwComposition>(new FwComposition(path, version)));
    std::string const name = getCompositionName(path);
    composition->_node = makeShd<FwNode>(composition, FwNode::Description{name, "composition", {}, {}});
    composition->_graph = makeShd<FwGraph>(composition, name, std::move(nodes));
    return composition;
}

FwComposition::Keeper FwComposition::keepApart(RCStrongPtr<FwComposition> const& composition)
{
    Keeper keeper = std::make_shared<RCStrongPtr<FwComposition>>(composition);
    composition->_keeper = keeper;
    return keeper;
}

FwComposition::~FwComposition() = default;

bool FwComposition::isApart() const
{
    Keeper const keeper = _keeper.lock();
    return keeper && !keeper->isNull();
}

RCStrongPtr<FwComposition> FwComposition::takeOver() const
{
    Keeper const keeper = _keeper.lock();
    return keeper ? std::exchange(*keeper, nullptr) : nullptr;
}

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

std::uint64_t FwComposition::getChangeCount() const
{
    return _changeCount;
}

PiUnsavedComposition FwComposition::getUnsaved() const
{
    return {_path, _version, FwCompositionWriter::write(*_graph)};
}

bool FwComposition::isChangedOnDisk() const
{
    try
    {
        return hasOtherVersion();
    }
    catch (ExBase const&)
    {
        return false;
    }
}

bool FwComposition::hasOtherVersion() const
{
    OsFile::Version const version = OsFile(_path).getVersion();
    return version != OsFile::Version{} && version != _version;
}

void FwComposition::save()
{
    if (hasOtherVersion())
        throw ExBase(__FILE__, __LINE__,
                     "Cannot save " + LiStringUtil::getPrintablePath(_path.toString()) +
                         ": the file has been changed on disk since it was opened");
    saveOver();
}

void FwComposition::saveOver()
{
    _version = OsFile(_path).replace(FwCompositionWriter::write(*_graph));
    setModified(false);
}

void FwComposition::setChangeCallback(std::function<void()> callback)
{
    _changeCallback = std::move(callback);
}

void FwComposition::setModified(bool isModified)
{
    _isModified = isModified;
    if (isModified)
        ++_changeCount;
    if (_changeCallback)
        _changeCallback();
}

} // namespace Kv
