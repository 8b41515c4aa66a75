#pragma once

#include <atomic>

namespace Kv
{

/// Counter that several threads may change at once.
template <typename Number> class LkCounter
{
public:
    void increment() { _value.fetch_add(1, std::memory_order_relaxed); }

    /// True when the count has come down to zero.
    bool decrement() { return _value.fetch_sub(1, std::memory_order_acq_rel) == 1; }

    Number get() const { return _value.load(std::memory_order_acquire); }

private:
    std::atomic<Number> _value{0};
};

/// Base of objects that are counted from inside and held through `RCShdPtr`.
/// A new object, also a copy, starts with the count zero; whoever brings it back to zero destroys the object.
template <typename Counter> class RCBase
{
public:
    virtual ~RCBase() = default;

    void addReference() const { _counter.increment(); }

    void releaseReference() const
    {
        if (_counter.decrement())
            delete this;
    }

    int getReferenceCount() const { return _counter.get(); }

protected:
    RCBase() = default;
    RCBase(RCBase const&) {}
    /// The count belongs to the object, not to its value.
    RCBase& operator=(RCBase const&) { return *this; } // NOLINT(cert-oop54-cpp)

private:
    mutable Counter _counter;
};

} // namespace Kv
