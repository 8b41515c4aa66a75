#pragma once

#include "ntPeer.h"

namespace Kv
{

/// Hears of the user of a push button.
class NtPushButtonListener
{
public:
    virtual ~NtPushButtonListener() = default;
    virtual void onPressed() = 0;
};

/// Button that Space, Enter and a click press.
class NtPushButton : public virtual NtPeer
{
public:
    using Listener = NtPushButtonListener;

    virtual void setText(std::string const& text) = 0;
    virtual void setAlign(NtAlign align) = 0;
};

} // namespace Kv
