#pragma once

#include "exBase.h"

namespace Kv
{

/// Thrown by an assertion that does not hold.
class KV_API ExAssertionFailed : public ExBase
{
public:
    using ExBase::ExBase;
    ExBase* clone() const override;
    [[noreturn]] void raise() const override;
};

/// Failing assertions are exceptions: they reach the caller and end nothing.
class KV_API Assertions
{
public:
    /// Throws `ExAssertionFailed`; its words hold `expression`.
    [[noreturn]] static void throwAssertionFailed(char const* sourcePath, int line, char const* expression);
};

} // namespace Kv
