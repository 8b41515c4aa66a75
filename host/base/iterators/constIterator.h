#pragma once

#include "iterators/iteratorVectorImp.h"
#include "pointers/rcPvtEngPtr.h"

#include <utility>
#include <vector>

namespace Kv
{

/// Walk forward over a sequence whose items stay as they are. Copies are cheap and independent. The item of one at its
/// end throws `ExAssertionFailed`.
template <typename T> class ConstIterator
{
public:
    explicit ConstIterator(std::vector<T> items) : _engine(makeShd<IteratorVectorImp<T>>(std::move(items))) {}

    bool atEnd() const { return _engine->atEnd(); }

    T const& operator*() const { return _engine->item(); }

    /// One step; stays at the end.
    ConstIterator& operator++()
    {
        _engine.makeOwn().next();
        return *this;
    }

private:
    RCPvtEngPtr<IteratorImp<T>> _engine;
};

} // namespace Kv
