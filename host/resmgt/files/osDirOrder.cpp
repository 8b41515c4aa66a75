#include "files/osDirOrder.h"

#include <algorithm>
#include <numeric>

namespace Kv
{

namespace
{

constexpr std::size_t firstRun = 256;

template <typename Number> int compare(Number a, Number b)
{
    return a < b ? -1 : int(b < a);
}

} // namespace

OsDirOrder::OsDirOrder(std::vector<OsDirEntry> const& entries, Key key, bool descending)
    : _entries(entries), _key(key), _descending(descending), _order(entries.size()), _run(firstRun)
{
    std::iota(_order.begin(), _order.end(), 0);
    _merged.reserve(_order.size());
}

bool OsDirOrder::step()
{
    if (_sorted < _order.size())
        sortRuns();
    else if (_run < _order.size())
        mergeSome();
    return _sorted >= _order.size() && _run >= _order.size();
}

bool OsDirOrder::comesBefore(int a, int b) const
{
    OsDirEntry const& first = _entries[static_cast<std::size_t>(a)];
    OsDirEntry const& second = _entries[static_cast<std::size_t>(b)];
    if (first.isDirectory != second.isDirectory)
        return first.isDirectory;
    int order = 0;
    // What a directory has of a size says nothing.
    if (_key == Size && !first.isDirectory)
        order = compare(first.size, second.size);
    else if (_key == Modified)
        order = compare(first.modified, second.modified);
    if (order == 0)
        order = first.sortKey.compare(second.sortKey);
    return _descending ? order > 0 : order < 0;
}

void OsDirOrder::sortRuns()
{
    auto const before = [this](int a, int b) { return comesBefore(a, b); };
    std::size_t const stop = std::min(_sorted + entriesPerStep, _order.size());
    while (_sorted < stop)
    {
        std::size_t const end = std::min(_sorted + firstRun, stop);
        std::sort(_order.begin() + static_cast<Index>(_sorted), _order.begin() + static_cast<Index>(end), before);
        _sorted = end;
    }
    beginMerge();
}

void OsDirOrder::mergeSome()
{
    for (std::size_t i = 0; i < entriesPerStep && _merged.size() < _order.size(); ++i)
    {
        bool const takesRight = _right < _rightEnd && (_left == _leftEnd || comesBefore(_order[_right], _order[_left]));
        _merged.push_back(_order[takesRight ? _right++ : _left++]);
        if (_left == _leftEnd && _right == _rightEnd)
            beginMerge();
    }
    if (_merged.size() < _order.size())
        return;
    _order.swap(_merged);
    _merged.clear();
    _run *= 2;
    beginMerge();
}

void OsDirOrder::beginMerge()
{
    _left = _merged.size();
    _leftEnd = std::min(_left + _run, _order.size());
    _right = _leftEnd;
    _rightEnd = std::min(_right + _run, _order.size());
}

} // namespace Kv
