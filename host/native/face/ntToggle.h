#pragma once

#include "ntPeer.h"

namespace Kv
{

/// Hears of the user of a toggle.
class NtToggleListener
{
public:
    virtual ~NtToggleListener() = default;
    virtual void onToggled(bool state) = 0;
};

/// Is on or off.
class NtToggle : public virtual NtPeer
{
public:
    using Listener = NtToggleListener;

    virtual void setState(bool state) = 0;
};

} // namespace Kv
