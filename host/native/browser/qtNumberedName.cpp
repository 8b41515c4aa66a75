#include "browser/qtNumberedName.h"

#include <algorithm>
#include <charconv>

namespace Kv
{

namespace
{

constexpr std::size_t leastDigits = 2;
/// All numbers of so many digits fit.
constexpr std::size_t mostDigits = 18;

constexpr int mostRanges = 3;

bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

/// The place of the extension, unless it is a number itself; else the end of the name.
std::size_t findExtension(std::string const& name)
{
    std::size_t const dot = name.rfind('.');
    if (dot == std::string::npos || dot == 0)
        return name.size();
    bool const isNumber = std::all_of(name.begin() + static_cast<std::ptrdiff_t>(dot) + 1, name.end(), &isDigit);
    return isNumber ? name.size() : dot;
}

std::string describeRange(std::uint64_t first, std::uint64_t last)
{
    return first == last ? std::to_string(first) : std::to_string(first) + "-" + std::to_string(last);
}

} // namespace

std::optional<QtNumberedName> QtNumberedName::parse(std::string const& name)
{
    std::size_t end = findExtension(name);
    while (end > 0)
    {
        while (end > 0 && !isDigit(name[end - 1]))
            --end;
        std::size_t begin = end;
        while (begin > 0 && isDigit(name[begin - 1]))
            --begin;
        std::size_t const digits = end - begin;
        if (digits >= leastDigits && digits <= mostDigits)
        {
            QtNumberedName parsed{name.substr(0, begin), name.substr(end), static_cast<int>(digits), 0};
            std::from_chars(name.data() + begin, name.data() + end, parsed.number);
            return parsed;
        }
        end = begin;
    }
    return std::nullopt;
}

std::string QtNumberedName::getSequenceKey() const
{
    return prefix + '/' + std::to_string(digits) + '/' + suffix;
}

std::string QtNumberedName::getPattern() const
{
    return prefix + std::string(static_cast<std::size_t>(digits), '#') + suffix;
}

std::string QtNumberedName::describe(std::vector<std::uint64_t> const& numbers)
{
    std::string text;
    int rangeCount = 0;
    for (auto first = numbers.begin(); first != numbers.end();)
    {
        auto last = first;
        while (last + 1 != numbers.end() && *(last + 1) == *last + 1)
            ++last;
        if (++rangeCount > mostRanges)
        {
            std::uint64_t const missing = numbers.back() - numbers.front() + 1 - numbers.size();
            return describeRange(numbers.front(), numbers.back()) + ", " + std::to_string(missing) + " missing";
        }
        text += (text.empty() ? "" : ", ") + describeRange(*first, *last);
        first = last + 1;
    }
    return text;
}

} // namespace Kv
