#include "appUi/uiCompositionWorkspaceListener.h"

namespace Kv
{

UiCompositionWorkspaceListener::~UiCompositionWorkspaceListener() = default;

} // namespace Kv
