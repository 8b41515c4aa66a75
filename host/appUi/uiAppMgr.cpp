#include "uiAppMgr.h"

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
    return _mainWindow;
}

RCShdPtr<UiTopLevel> UiAppMgr::getMainWindow() const
{
    return _mainWindow;
}

RCShdPtr<UiPanel> UiAppMgr::getMainPanel() const
{
    return _mainPanel;
}

RCShdPtr<SnSelection> UiAppMgr::getSelection() const
{
    return _view ? _view->getSelection() : nullptr;
}

void UiAppMgr::setApplication(RCShdPtr<UiMainWindow> const& window, RCShdPtr<UiPanel> const& panel,
                              RCShdPtr<UiView> const& view)
{
    _view = view;
    _mainWindow = window;
    _mainPanel = panel;
}

void UiAppMgr::setTopLevel(RCShdPtr<UiTopLevel> const& window)
{
    forgetHidden();
    std::weak_ptr<UiTopLevel> const told = window->observe();
    auto const isSame = [&told](std::weak_ptr<UiTopLevel> const& other)
    { return !other.owner_before(told) && !told.owner_before(other); };
    _told.erase(std::remove_if(_told.begin(), _told.end(), isSame), _told.end());
    window->setOwner(_told.empty() ? std::weak_ptr<UiTopLevel>() : _told.back());
    _told.push_back(told);
}

void UiAppMgr::releaseTopLevel()
{
    forgetHidden();
}

void UiAppMgr::forgetHidden()
{
    auto const isHidden = [](std::weak_ptr<UiTopLevel> const& told)
    {
        std::shared_ptr<UiTopLevel> const window = told.lock();
        return !window || !window->isShown();
    };
    _told.erase(std::remove_if(_told.begin(), _told.end(), isHidden), _told.end());
}

UiAppDisabler::UiAppDisabler() : _window(dynamicCast<UiMainWindow>(UiAppMgr::getInstance().getMainWindow()))
{
    if (_window)
        _window->refuseInput();
}

UiAppDisabler::~UiAppDisabler()
{
    if (_window)
        _window->admitInput();
}

} // namespace Kv
