#pragma once

#include "kvExport.h"
#include "ntWindow.h"
#include "pointers/rcBase.h"

#include <memory>

namespace Kv
{

/// A window of the window system; owns its native side.
class KV_API WsWindow : public RCBase<LkCounter<int>>
{
public:
    explicit WsWindow(std::unique_ptr<NtWindow> native);
    ~WsWindow() override;

    NtWindow& getNative() { return *_native; }

    /// Drops the input that is still queued for the window.
    void flushAllEvents();

private:
    std::unique_ptr<NtWindow> _native;
};

} // namespace Kv
