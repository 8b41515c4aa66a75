#pragma once

#include "files/osDirScan.h"

#include <utility>
#include <vector>

namespace Kv
{

/// Sorts the entries of a directory a step at a time, so that a loop can run in between whatever their number.
/// Directories always come first; what counts alike comes by its name.
class KV_API OsDirOrder
{
public:
    enum Key
    {
        Name,
        Size,
        Modified,
    };

    /// How many entries one step moves at most.
    static constexpr std::size_t entriesPerStep = 4096;

    /// `entries` is borrowed and stays as it is until the order is taken.
    OsDirOrder(std::vector<OsDirEntry> const& entries, Key key, bool descending);

    /// True once all is sorted.
    bool step();

    /// The indices of the entries, sorted.
    std::vector<int> take() { return std::move(_order); }

private:
    using Index = std::vector<int>::difference_type;

    bool comesBefore(int a, int b) const;
    void sortRuns();
    void mergeSome();
    void beginMerge();

    std::vector<OsDirEntry> const& _entries;
    Key _key;
    bool _descending;
    std::vector<int> _order;
    std::vector<int> _merged;
    /// Runs of this many are sorted; the runs up to `_sorted` in the first pass.
    std::size_t _run;
    std::size_t _sorted = 0;
    /// The merge under way: where its two runs go on and end.
    std::size_t _left = 0;
    std::size_t _leftEnd = 0;
    std::size_t _right = 0;
    std::size_t _rightEnd = 0;
};

} // namespace Kv
