#pragma once

#include "kvExport.h"
#include "text/liString.h"

namespace Kv
{

/// Holds a cursor for as long as it lives; then the cursor that was current when it was made is current again.
class KV_API UiCursorGuard
{
public:
    /// Throws an `ExBase` that lists the names for a name that no cursor has.
    explicit UiCursorGuard(LiString const& cursorName);
    UiCursorGuard(UiCursorGuard const&) = delete;
    UiCursorGuard& operator=(UiCursorGuard const&) = delete;
    ~UiCursorGuard();

private:
    LiString _previous;
};

} // namespace Kv
