#pragma once

#include "ui/uiContainer.h"
#include "ui/uiPushButton.h"

namespace Kv
{

/// The push button in a container that Escape presses: the one labelled "Cancel", else the only one. One that is not
/// displayed does not count. Null if there is none.
RCShdPtr<UiPushButton> findEscapeButton(UiContainer const& container);

} // namespace Kv
