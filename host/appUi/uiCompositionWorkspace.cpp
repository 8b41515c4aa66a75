#include "uiCompositionWorkspace.h"

#include "brBrowser.h"
#include "fwComposition.h"
#include "pointers/rcWeakPtr.h"
#include "text/liString.h"
#include "uiContainer.h"

#include <algorithm>
#include <utility>

namespace Kv
{

namespace
{

/// The composition if a script has read it and no workspace has taken it over; null otherwise.
template <typename Controller> RCStrongPtr<FwComposition const> findApart(std::shared_ptr<Controller> const& controller)
{
    auto composition = std::dynamic_pointer_cast<FwComposition const>(controller);
    return composition && composition->isApart() ? composition : nullptr;
}

} // namespace

UiCompositionWorkspaceClientInterface::~UiCompositionWorkspaceClientInterface() = default;

UiCompositionWorkspace::UiCompositionWorkspace(FocusFinder findFocus) : _findFocus(std::move(findFocus)) {}

UiCompositionWorkspace::~UiCompositionWorkspace()
{
    // Whoever goes through one just now holds it a little longer.
    for (RCStrongPtr<FwComposition> const& composition : _compositions)
        composition->setChangeCallback(nullptr);
}

void UiCompositionWorkspace::setChangeCallback(std::function<void()> callback)
{
    _changeCallback = std::move(callback);
}

RCWeakPtr<const PiCompositionGraphInterface> UiCompositionWorkspace::open(OsFilePath const& path)
{
    OsFilePath const canonical = path.getCanonical();
    if (auto const known = find(canonical); known != _compositions.end())
    {
        RCWeakPtr<const PiCompositionGraphInterface> composition = *known;
        setCurrent(*known);
        return composition;
    }
    RCStrongPtr<FwComposition> const composition = FwComposition::open(canonical);
    add(composition);
    return composition;
}

void UiCompositionWorkspace::close(RCWeakPtr<const PiCompositionGraphInterface> const& composition)
{
    RCStrongPtr<FwComposition> const closing = require(composition);
    closing->setChangeCallback(nullptr);
    auto const next = _compositions.erase(find(closing->getPath()));
    bool const wasCurrent = closing.get() == _current.get();
    if (wasCurrent && _compositions.empty())
        _current = nullptr;
    else if (wasCurrent)
        _current = next == _compositions.end() ? _compositions.back() : *next;
    tellChange();
}

void UiCompositionWorkspace::save(RCWeakPtr<const PiCompositionGraphInterface> const& composition)
{
    require(composition)->save();
}

void UiCompositionWorkspace::saveOver(RCWeakPtr<const PiCompositionGraphInterface> const& composition)
{
    require(composition)->saveOver();
}

void UiCompositionWorkspace::makeCurrent(RCWeakPtr<const PiCompositionGraphInterface> const& composition)
{
    setCurrent(require(composition));
}

UPtr<UiWidget> UiCompositionWorkspace::getFocus() const
{
    UPtr<UiWidget> const holder = _findFocus ? _findFocus() : nullptr;
    RCShdPtr<UiContainer> const around = holder.isNull() ? nullptr : holder->getParent();
    if (!around)
        return holder;
    // A button beside a browser is there for what is selected in it.
    for (RCShdPtr<UiWidget> const& child : around->getChildren())
        if (dynamic_cast<BrBrowser*>(child.get()))
            return child.get();
    return holder;
}

RCWeakPtr<const PiCompositionGraphInterface> UiCompositionWorkspace::getCurrentComposition() const
{
    return _current;
}

void UiCompositionWorkspace::openComposition(RCWeakPtr<const PiCompositionGraphInterface> const& composition)
{
    RCStrongPtr<FwComposition const> const apart = findApart(composition.lock());
    if (apart.isNull())
    {
        makeCurrent(composition);
        return;
    }
    auto const known = find(apart->getPath());
    if (known == _compositions.end())
    {
        // First, since what is taken over would go where it finds no place.
        _compositions.reserve(_compositions.size() + 1);
        add(apart->takeOver());
    }
    else if (apart->isModified())
        throw ExBase(__FILE__, __LINE__,
                     "Cannot open " + LiStringUtil::getPrintablePath(apart->getPath().toString()) +
                         ": it is open already, and what was read has changes that are not saved");
    else
        setCurrent(*known);
}

RCWeakPtr<const PiCompositionGraphInterface>
UiCompositionWorkspace::getComposition(RCShdPtr<const PiGraph> const& graph) const
{
    for (RCStrongPtr<const FwComposition> const composition : _compositions)
        if (composition->getGraph() == graph)
            return composition;
    return graph ? findApart(graph->getController().lock()) : nullptr;
}

bool UiCompositionWorkspace::isCompositionEditable(
    RCWeakPtr<const PiCompositionGraphInterface> const& composition) const
{
    RCWeakAccessor<const PiCompositionGraphInterface> const accessor(composition);
    return !accessor.isNull() && accessor->isEditable();
}

bool UiCompositionWorkspace::isCompositionOpened(OsFilePath const& path) const
{
    return find(path.getCanonical()) != _compositions.end();
}

unsigned int UiCompositionWorkspace::getNbCompositions() const
{
    return static_cast<unsigned int>(_compositions.size());
}

ConstIterator<RCWeakPtr<const PiCompositionGraphInterface>> UiCompositionWorkspace::getCompositions() const
{
    return ConstIterator<RCWeakPtr<const PiCompositionGraphInterface>>({_compositions.begin(), _compositions.end()});
}

/// `path` is canonical.
UiCompositionWorkspace::Compositions::const_iterator UiCompositionWorkspace::find(OsFilePath const& path) const
{
    return std::find_if(_compositions.begin(), _compositions.end(),
                        [&path](RCStrongPtr<FwComposition> const& composition)
                        { return composition->getPath() == path; });
}

void UiCompositionWorkspace::add(RCStrongPtr<FwComposition> const& composition)
{
    _compositions.push_back(composition);
    composition->setChangeCallback([this] { tellChange(); });
    setCurrent(composition);
}

RCStrongPtr<FwComposition>
UiCompositionWorkspace::require(RCWeakPtr<const PiCompositionGraphInterface> const& composition) const
{
    for (RCStrongPtr<FwComposition> const& open : _compositions)
        if (RCWeakPtr<const PiCompositionGraphInterface>(open) == composition)
            return open;
    throw ExBase(__FILE__, __LINE__, "The composition is not open: it has been closed");
}

void UiCompositionWorkspace::setCurrent(RCStrongPtr<FwComposition> const& composition)
{
    if (composition.get() == _current.get())
        return;
    _current = composition;
    tellChange();
}

void UiCompositionWorkspace::tellChange() const
{
    if (_changeCallback)
        _changeCallback();
}

} // namespace Kv
