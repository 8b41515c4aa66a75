#pragma once

#include "assertions.h"
#include "iterators/iteratorImp.h"

#include <cstddef>
#include <utility>
#include <vector>

namespace Kv
{

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

} // namespace Kv
