#include "wsCursorRegistry.h"

#include "wsNative.h"
#include "wsThread.h"

namespace Kv
{

namespace
{

NtCursor shapeOf(LiString const& name)
{
    if (name == WsCursorRegistry::Normal)
        return NtCursor::Normal;
    if (name == WsCursorRegistry::Busy)
        return NtCursor::Busy;
    throw ExBase(__FILE__, __LINE__,
                 "Unknown cursor \"" + name.toString() + "\": the cursors are \"" +
                     WsCursorRegistry::Normal.toString() + "\" and \"" + WsCursorRegistry::Busy.toString() + "\"");
}

} // namespace

LiString const WsCursorRegistry::Normal("normal");
LiString const WsCursorRegistry::Busy("busy");

WsCursorRegistry& WsCursorRegistry::getInstance()
{
    static WsCursorRegistry registry;
    return registry;
}

void WsCursorRegistry::setCurrent(LiString const& name)
{
    WsThread::require("Cursor");
    shapeOf(name);
    _current = name;
    apply();
}

void WsCursorRegistry::restore(LiString const& name) noexcept
{
    // At the end of a guard nobody can be told what fails: the next change gives the pointer its shape.
    try
    {
        _current = name;
        if (WsThread::isCurrent())
            apply();
    }
    catch (...) // NOLINT(bugprone-empty-catch)
    {
    }
}

void WsCursorRegistry::apply() const
{
    if (NtPlatform* const platform = WsNative::getLoadedPlatform())
        platform->setCursor(shapeOf(_current));
}

} // namespace Kv
