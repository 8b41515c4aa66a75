#pragma once

#include "kvExport.h"

#include <cstddef>
#include <exception>
#include <string>

namespace Kv
{

/// Base of every exception of the host. Carries words for a person and the place in the source that threw it.
class KV_API ExBase : public std::exception
{
public:
    /// The bytes beyond which a reason loses its middle. There is room for the longest of paths.
    static constexpr std::size_t mostBytes = 10'000;

    /// `sourcePath` and `line` tell where it is thrown, `reason` what is wrong. Bytes of the reason that are no UTF-8,
    /// as those of a path can be, stand as escapes in it.
    ExBase(char const* sourcePath, int line, std::string reason);
    ExBase(ExBase const&);
    ExBase& operator=(ExBase const&);
    ~ExBase() override;

    /// The reason, as `getReason` gives it.
    char const* what() const noexcept override;

    /// The fault, in words.
    virtual char const* getReason() const;

    /// The reason with the place in the source behind it.
    virtual char const* getDetailedReason() const;

    /// A copy on the heap, owned by the caller.
    virtual ExBase* clone() const;

    /// Throws a copy of this exception under its exact type.
    [[noreturn]] virtual void raise() const;

private:
    std::string _reason;
    std::string _detailedReason;
};

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
