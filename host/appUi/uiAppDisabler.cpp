#include "uiAppDisabler.h"

#include "uiAppMgr.h"

namespace Kv
{

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
