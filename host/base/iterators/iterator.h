#pragma once

#include "iterators/iteratorVectorImp.h"
#include "pointers/rcPvtEngPtr.h"

#include <cstddef>
#include <iterator>
#include <utility>
#include <vector>

namespace Kv
{

/// Walk over a sequence in both directions, begun at its first item. Copies are cheap and independent: they share what
/// they walk over until one of them moves, or gives its item for changing. One without a sequence, as by default,
/// throws `ExNullPtr` for every operation; the item of one at its end throws `ExAssertionFailed`.
template <typename T> class Iterator
{
public:
    using iterator_category = std::bidirectional_iterator_tag;
    using value_type = T;
    using difference_type = std::ptrdiff_t;
    using pointer = T*;
    using reference = T&;

    Iterator() = default;
    explicit Iterator(std::vector<T> items) : _engine(makeShd<IteratorVectorImp<T>>(std::move(items))) {}
    explicit Iterator(RCShdPtr<IteratorImp<T>> engine) : _engine(std::move(engine)) {}
    Iterator(Iterator const&) = default;
    Iterator& operator=(Iterator const&) = default;
    virtual ~Iterator();

    virtual T const* operator->() const { return &_engine->item(); }
    virtual T* operator->() { return &_engine.makeOwn().item(); }
    virtual T const& item() const { return _engine->item(); }
    virtual T& item() { return _engine.makeOwn().item(); }
    virtual T const& operator*() const { return _engine->item(); }
    virtual T& operator*() { return _engine.makeOwn().item(); }

    virtual void first() { _engine.makeOwn().first(); }
    virtual void last() { _engine.makeOwn().last(); }

    /// Goes behind the last item.
    virtual void end() { _engine.makeOwn().end(); }

    virtual bool atEnd() const { return _engine->atEnd(); }
    virtual bool atBegin() const { return _engine->atBegin(); }

    /// One step; stays where there is none to take.
    virtual void next() { _engine.makeOwn().next(); }
    virtual void previous() { _engine.makeOwn().previous(); }

    /// How many items the whole walk has.
    virtual int getCardinality() const { return _engine->getCardinality(); }

    virtual Iterator operator++(int) // NOLINT(cert-dcl21-cpp)
    {
        Iterator before(*this);
        next();
        return before;
    }
    virtual Iterator& operator++()
    {
        next();
        return *this;
    }
    virtual Iterator operator--(int) // NOLINT(cert-dcl21-cpp)
    {
        Iterator before(*this);
        previous();
        return before;
    }
    virtual Iterator& operator--()
    {
        previous();
        return *this;
    }

private:
    RCPvtEngPtr<IteratorImp<T>> _engine;
};

template <typename T> Iterator<T>::~Iterator() = default;

} // namespace Kv
