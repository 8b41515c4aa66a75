#pragma once

#include <cstddef>
#include <utility>
#include <vector>

namespace Kv
{

/// Walk over a sequence of its own, taken when the iterator was made.
template <typename T> class Iterator
{
public:
    explicit Iterator(std::vector<T> items) : _items(std::move(items)) {}

    void first() { _position = 0; }
    void next() { ++_position; }
    bool atEnd() const { return _position >= _items.size(); }

    /// The item at hand; only while not `atEnd`.
    T const& item() const { return _items.at(_position); }

    /// How many items the whole walk has.
    int getCardinality() const { return static_cast<int>(_items.size()); }

private:
    std::vector<T> _items;
    std::size_t _position = 0;
};

} // namespace Kv
