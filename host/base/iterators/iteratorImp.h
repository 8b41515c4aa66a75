#pragma once

#include "pointers/rcShdPtr.h"

namespace Kv
{

/// Engine of an iterator: a sequence and a place in it, counted and shared by the copies of the iterator.
template <typename T> class IteratorImp : public RCBase<LkCounter<int>>
{
public:
    /// The same place in the same sequence; changing the one leaves the other alone.
    virtual RCShdPtr<IteratorImp> clone() const = 0;

    /// The item at hand. Throws `ExAssertionFailed` at the end.
    virtual T const& item() const = 0;
    virtual T& item() = 0;

    virtual void first() = 0;
    virtual void last() = 0;
    virtual void end() = 0;
    virtual bool atEnd() const = 0;
    virtual bool atBegin() const = 0;

    /// One step, which does not leave the sequence: at the end there is no next, at the begin no previous item.
    virtual void next() = 0;
    virtual void previous() = 0;

    virtual int getCardinality() const = 0;
};

} // namespace Kv
