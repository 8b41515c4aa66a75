#pragma once

#include <functional>
#include <utility>

namespace Kv
{

/// Yes-or-no question about an object; two of them join with `&&`.
template <typename T> class PrdPredicate
{
public:
    explicit PrdPredicate(std::function<bool(T const&)> test) : _test(std::move(test)) {}

    bool holds(T const& object) const { return _test(object); }

    /// Holds where both hold; the second is asked only if the first says yes.
    friend PrdPredicate operator&&(PrdPredicate first, PrdPredicate second)
    {
        return PrdPredicate([first = std::move(first), second = std::move(second)](T const& object)
                            { return first.holds(object) && second.holds(object); });
    }

private:
    std::function<bool(T const&)> _test;
};

} // namespace Kv
