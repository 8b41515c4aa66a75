#pragma once

#include "kvExport.h"
#include "pointers/rcShdPtr.h"
#include "uiMainWindow.h"

namespace Kv
{

/// Keeps the application's own widgets from taking input for as long as it lives, while the floating containers that
/// come to the front meanwhile stay usable. The last one to go leaves the application as it was. Without an application
/// it does nothing.
class KV_API UiAppDisabler
{
public:
    UiAppDisabler();
    UiAppDisabler(UiAppDisabler const&) = delete;
    UiAppDisabler& operator=(UiAppDisabler const&) = delete;
    ~UiAppDisabler();

private:
    RCShdPtr<UiMainWindow> _window;
};

} // namespace Kv
