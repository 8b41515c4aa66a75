#pragma once

#include "exBase.h"
#include "pointers/rcShdPtr.h"

#include <cstddef>
#include <iterator>
#include <utility>
#include <vector>

namespace Kv
{

/// Row of values.
template <typename T> using Vector = std::vector<T>;

/// Pointer of a handle to its engine. Copies of the handle share one engine until one of them is about to change it.
/// Going through a null one throws `ExNullPtr`.
template <typename Engine> class RCPvtEngPtr
{
public:
    RCPvtEngPtr() = default;
    explicit RCPvtEngPtr(RCShdPtr<Engine> engine) : _engine(std::move(engine)) {}

    /// The engine to be looked at, shared or not.
    Engine const* operator->() const { return _engine.operator->(); }

    /// The engine to be changed; where others have it too, this pointer takes a clone first.
    Engine& makeOwn()
    {
        if (_engine->getReferenceCount() != 1)
            _engine = _engine->clone();
        return *_engine;
    }

private:
    RCShdPtr<Engine> _engine;
};

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

/// Engine over a sequence of its own.
template <typename T> class IteratorVectorImp : public IteratorImp<T>
{
public:
    explicit IteratorVectorImp(std::vector<T> items) : _items(std::move(items)) {}

    RCShdPtr<IteratorImp<T>> clone() const override { return makeShd<IteratorVectorImp>(*this); }

    T const& item() const override
    {
        requireItem();
        return _items[_position];
    }
    T& item() override
    {
        requireItem();
        return _items[_position];
    }

    void first() override { _position = 0; }
    void last() override { _position = _items.empty() ? 0 : _items.size() - 1; }
    void end() override { _position = _items.size(); }
    bool atEnd() const override { return _position == _items.size(); }
    bool atBegin() const override { return _position == 0; }

    void next() override
    {
        if (!atEnd())
            ++_position;
    }
    void previous() override
    {
        if (!atBegin())
            --_position;
    }

    int getCardinality() const override { return static_cast<int>(_items.size()); }

private:
    void requireItem() const
    {
        if (atEnd())
            Assertions::throwAssertionFailed(__FILE__, __LINE__, "!atEnd()");
    }

    std::vector<T> _items;
    std::size_t _position = 0;
};

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

    /// The number of items in the whole walk.
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
