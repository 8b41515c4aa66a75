#pragma once

#include "ntPeer.h"

namespace Kv
{

/// Hears of the user of a menu.
class NtMenuListener
{
public:
    virtual ~NtMenuListener() = default;
    /// The user picked an entry, maybe the one that was selected already.
    virtual void onPicked(int index) = 0;
};

/// List of entries to pick one from; none may be selected.
class NtMenu : public virtual NtPeer
{
public:
    using Listener = NtMenuListener;

    virtual void removeAll() = 0;
    /// Adds an entry at the end and selects nothing.
    virtual void append(std::string const& entry) = 0;
    /// Selects an entry, or none for -1.
    virtual void select(int index) = 0;
    virtual void setAlign(NtAlign align) = 0;
};

} // namespace Kv
