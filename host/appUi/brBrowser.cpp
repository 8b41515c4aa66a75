#include "brBrowser.h"

#include "brBrowsable.h"
#include "exBase.h"
#include "files/osAsync.h"
#include "files/osPlace.h"
#include "fwComposition.h"
#include "uiContainer.h"

#include <filesystem>
#include <system_error>
#include <utility>

namespace Kv
{

namespace
{

/// Those entries of a directory that are there, also links that lead nowhere; all, if it does not answer in time.
std::vector<std::string> findThere(std::string const& directory, std::vector<std::string> const& names)
{
    auto const look = [directory, names]
    {
        std::vector<std::string> found;
        for (std::string const& name : names)
            if (std::error_code error;
                std::filesystem::exists(std::filesystem::symlink_status(OsPlace::join(directory, name), error)))
                found.push_back(name);
        return found;
    };
    return OsAsync::ask(OsAsync::getEntries(directory), look).value_or(names);
}

} // namespace

/// Client data outlives the widget where somebody holds it, and then has no selection.
class BrBrowser::View : public UiView
{
public:
    explicit View(BrBrowser const& browser) : _browser(&browser) {}

    void close() { _browser = nullptr; }

    RCShdPtr<SnSelection> getSelection() override { return _browser ? _browser->makeSelection() : nullptr; }

private:
    BrBrowser const* _browser;
};

BrBrowser::BrBrowser(std::string name) : UiPeeredWidget(std::move(name)), _view(makeShd<View>(*this))
{
    addClientData(_view);
}

BrBrowser::~BrBrowser()
{
    _view->close();
}

RCShdPtr<BrBrowser> BrBrowser::create(RCShdPtr<UiContainer> const& parent, char const* name, UiResTable const*)
{
    RCShdPtr<BrBrowser> browser(new BrBrowser(name));
    parent->addChild(browser);
    return browser;
}

bool BrBrowser::isComposition(std::string const& name)
{
    return std::filesystem::path(name).extension() == FwComposition::extension;
}

bool BrBrowser::isScript(std::string const& name)
{
    return std::filesystem::path(name).extension() == ".py";
}

void BrBrowser::setFolderOption(PaneEnum) {}

void BrBrowser::setViewType(BrTypes::ViewType) {}

void BrBrowser::setSequencesCollapsed(bool collapsed)
{
    requireUiThread();
    _sequencesCollapsed = collapsed;
    if (NtBrowser* const peer = getPeer())
        showCollapsing(*peer);
}

void BrBrowser::setCompositionsCollapsed(bool collapsed)
{
    requireUiThread();
    _compositionsCollapsed = collapsed;
    if (NtBrowser* const peer = getPeer())
        showCollapsing(*peer);
}

void BrBrowser::setDontLoadCompositions(bool dontLoad)
{
    requireUiThread();
    _dontLoadCompositions = dontLoad;
}

void BrBrowser::setLoadCb(CbHandler<EvEvent>* handler)
{
    requireUiThread();
    _loadCb = handler;
}

void BrBrowser::setMultiple(bool multiple)
{
    requireUiThread();
    _multiple = multiple;
    if (NtBrowser* const peer = getPeer())
        peer->setMultiple(multiple);
}

bool BrBrowser::setURL(LiString const& url, HistoryEnum, UpdateEnum)
{
    requireUiThread();
    OsPlace place;
    try
    {
        place = OsPlace::findInTime(OsPlace::complete(url.toString(), ""));
    }
    catch (ExBase const&)
    {
        return false;
    }
    onDirectoryChanged(place.directory);
    if (!place.name.empty())
        onSelectionChanged(place.name, {place.name});
    if (NtBrowser* const peer = getPeer())
        peer->goTo(_directory, _focus, _selected);
    return true;
}

void BrBrowser::select(RCShdPtr<SnSelection> const& selection)
{
    requireUiThread();
    if (!selection)
        return;
    using Convert = SnItemConvert<RCShdPtr<BrBrowsable>>;
    RCShdPtr<const SnSelection> const browsables = selection->filter(Convert::getPredicate());
    std::vector<std::string> names;
    for (RCShdPtr<const SnItem> const& item : *browsables)
    {
        std::filesystem::path const path = Convert::get(item)->getPath().toString();
        if (path.parent_path() == _directory && path.has_filename())
            names.push_back(path.filename());
    }
    if (names.empty())
        return;
    if (!_multiple)
        names.resize(1);
    onSelectionChanged(names.front(), names);
    if (NtBrowser* const peer = getPeer())
        peer->goTo(_directory, _focus, _selected);
}

LiString BrBrowser::getInputFocusPath() const
{
    if (!_newPath.empty())
        return _newPath;
    if (_focus.empty() || findThere(_directory, {_focus}).empty())
        return {};
    return OsPlace::join(_directory, _focus);
}

LiString BrBrowser::getPath() const
{
    return _directory;
}

RCShdPtr<UiView> BrBrowser::getView() const
{
    return _view;
}

void BrBrowser::setTakesNew(bool takesNew)
{
    requireUiThread();
    _takesNew = takesNew;
}

void BrBrowser::takeTypedPath(std::function<void()> taken)
{
    RCShdPtr<BrBrowser> const self(this);
    requireUiThread();
    _newPath.clear();
    _taken = std::move(taken);
    if (NtBrowser* const peer = getPeer())
        peer->takeTypedPath(_takesNew);
    else
        onTypedPathTaken("");
}

void BrBrowser::showState(NtBrowser& peer)
{
    showCollapsing(peer);
    peer.setMultiple(_multiple);
    peer.goTo(_directory, _focus, _selected);
}

void BrBrowser::onDirectoryChanged(std::string const& directory)
{
    _directory = directory;
    onSelectionChanged("", {});
}

void BrBrowser::onSelectionChanged(std::string const& focus, std::vector<std::string> const& selected)
{
    _focus = focus;
    _selected = selected;
    _newPath.clear();
}

void BrBrowser::onActivated()
{
    RCShdPtr<BrBrowser> const self(this);
    if (!takesInput())
        return;
    EvEvent event(PiWidget::Activate);
    if (_loadCb && !_dontLoadCompositions && isComposition(_focus))
        _loadCb->call(event);
    else
        fire(PiWidget::Activate);
}

void BrBrowser::onTypedPathTaken(std::string const& newPath)
{
    RCShdPtr<BrBrowser> const self(this);
    _newPath = newPath;
    if (auto const taken = std::exchange(_taken, nullptr))
        taken();
}

void BrBrowser::showCollapsing(NtBrowser& peer) const
{
    peer.setCollapsing([sequences = _sequencesCollapsed, compositions = _compositionsCollapsed](std::string const& name)
                       { return isComposition(name) ? compositions : sequences && !isScript(name); });
}

RCShdPtr<SnSelection> BrBrowser::makeSelection() const
{
    SnSelection::Items items;
    if (_newPath.empty() && !_selected.empty())
        for (std::string const& name : findThere(_directory, _selected))
            items.push_back(makeShd<BrBrowsableItem>(makeShd<BrBrowsable>(OsPlace::join(_directory, name))));
    return makeShd<SnSelection>(std::move(items));
}

} // namespace Kv
