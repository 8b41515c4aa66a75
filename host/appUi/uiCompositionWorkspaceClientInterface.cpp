#include "uiCompositionWorkspaceClientInterface.h"

namespace Kv
{

UiCompositionWorkspaceClientInterface::~UiCompositionWorkspaceClientInterface() = default;

} // namespace Kv
