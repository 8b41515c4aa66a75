#include "appUi/uiAppMgr.h"

#include <algorithm>

namespace Kv
{

UiAppMgr& UiAppMgr::getInstance()
{
    static UiAppMgr manager;
    return manager;
}

RCShdPtr<UiTopLevel> UiAppMgr::getTopLevel() const
{
    return nullptr;
}

void UiAppMgr::setTopLevel(RCShdPtr<UiTopLevel> const& window)
{
    auto const isGoneOrSame = [&window](std::weak_ptr<UiTopLevel> const& told)
    {
        std::shared_ptr<UiTopLevel> const alive = told.lock();
        return !alive || alive.get() == window.get();
    };
    _told.erase(std::remove_if(_told.begin(), _told.end(), isGoneOrSame), _told.end());
    window->setOwner(_told.empty() ? std::weak_ptr<UiTopLevel>() : _told.back());
    _told.push_back(window->observe());
}

void UiAppMgr::releaseTopLevel()
{
    auto const isGone = [](std::weak_ptr<UiTopLevel> const& told) { return told.expired(); };
    _told.erase(std::remove_if(_told.begin(), _told.end(), isGone), _told.end());
    if (!_told.empty())
        _told.pop_back();
}

} // namespace Kv
