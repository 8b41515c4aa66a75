#pragma once

#include "kvExport.h"
#include "ntPlatform.h"
#include "text/liString.h"

namespace Kv
{

/// The cursors by name, and the current one. A change is seen once there is a window system; before that it is only
/// remembered.
class KV_API WsCursorRegistry
{
public:
    /// "normal": each widget's own pointer.
    static LiString const Normal;
    /// "busy": the pointer that asks for patience.
    static LiString const Busy;

    static WsCursorRegistry& getInstance();

    LiString const& getCurrent() const { return _current; }

    /// Throws an `ExBase` that lists the names for a name that is none of them; the cursor stays as it is then.
    void setCurrent(LiString const& name);

    /// Goes back to a cursor that was current before, from any thread; a change is shown on the user interface's own.
    void restore(LiString const& name) noexcept;

    /// Shows the current cursor; for a window system that has just come.
    void apply() const;

private:
    LiString _current = Normal;
};

} // namespace Kv
