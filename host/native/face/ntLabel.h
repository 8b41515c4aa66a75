#pragma once

#include "ntPeer.h"

namespace Kv
{

/// A text that the user reads.
class NtLabel : public virtual NtPeer
{
public:
    using Listener = NtNoListener;

    virtual void setText(std::string const& text) = 0;
    virtual void setAlign(NtAlign align) = 0;
};

} // namespace Kv
