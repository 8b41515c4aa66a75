#include "uiCursorGuard.h"

#include "wsCursorRegistry.h"

namespace Kv
{

UiCursorGuard::UiCursorGuard(LiString const& cursorName) : _previous(WsCursorRegistry::getInstance().getCurrent())
{
    WsCursorRegistry::getInstance().setCurrent(cursorName);
}

UiCursorGuard::~UiCursorGuard()
{
    WsCursorRegistry::getInstance().restore(_previous);
}

} // namespace Kv
