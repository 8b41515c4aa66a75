#pragma once

#include "uiContainer.h"
#include "uiPushButton.h"

namespace Kv
{

/// The push button in a container that Escape presses: the one labelled "Cancel", else the only one, but not where a
/// widget holds a value, as that must never be taken for confirmed. A button that is not displayed does not count. Null
/// if there is none.
RCShdPtr<UiPushButton> findEscapeButton(UiContainer const& container);

/// True for a container that asks a question and nothing else: no widget in it holds a value, and more than one push
/// button is displayed.
bool needsAnswer(UiContainer const& container);

} // namespace Kv
