#include "resmgt/xmlSyntax.h"

#include <algorithm>
#include <array>
#include <utf8.h>

namespace Kv::XmlSyntax
{

namespace
{

struct Range
{
    std::uint32_t first;
    std::uint32_t last;
};

// Ordered, so that a search can halve them.
constexpr std::array<Range, 16> nameStarts = {{{':', ':'},
                                               {'A', 'Z'},
                                               {'_', '_'},
                                               {'a', 'z'},
                                               {0xc0, 0xd6},
                                               {0xd8, 0xf6},
                                               {0xf8, 0x2ff},
                                               {0x370, 0x37d},
                                               {0x37f, 0x1fff},
                                               {0x200c, 0x200d},
                                               {0x2070, 0x218f},
                                               {0x2c00, 0x2fef},
                                               {0x3001, 0xd7ff},
                                               {0xf900, 0xfdcf},
                                               {0xfdf0, 0xfffd},
                                               {0x10000, 0xeffff}}};
constexpr std::array<Range, 5> nameFollowers = {
    {{'-', '.'}, {'0', '9'}, {0xb7, 0xb7}, {0x300, 0x36f}, {0x203f, 0x2040}}};

template <std::size_t Count> bool isIn(std::array<Range, Count> const& ranges, std::uint32_t codePoint)
{
    auto const endsBefore = [](Range const& range, std::uint32_t value) { return range.last < value; };
    auto const range = std::lower_bound(ranges.begin(), ranges.end(), codePoint, endsBefore);
    return range != ranges.end() && range->first <= codePoint;
}

} // namespace

bool isCharacter(std::uint32_t codePoint)
{
    if (codePoint < 0x20)
        return codePoint == '\t' || codePoint == '\n' || codePoint == '\r';
    return codePoint < 0xd800 || (codePoint > 0xdfff && codePoint < 0xfffe) ||
           (codePoint >= 0x10000 && codePoint <= 0x10ffff);
}

bool isName(std::string_view text)
{
    if (text.empty() || !utf8::is_valid(text.begin(), text.end()))
        return false;
    auto const* place = text.data();
    auto const* const end = place + text.size();
    if (!isIn(nameStarts, utf8::unchecked::next(place)))
        return false;
    while (place != end)
    {
        std::uint32_t const codePoint = utf8::unchecked::next(place);
        if (!isIn(nameStarts, codePoint) && !isIn(nameFollowers, codePoint))
            return false;
    }
    return true;
}

std::optional<Offence> findOffence(std::string_view text)
{
    auto const* const begin = text.data();
    auto const* const end = begin + text.size();
    auto const* const validEnd = utf8::find_invalid(begin, end);
    for (auto const* place = begin; place != validEnd;)
    {
        auto const* const character = place;
        if (!isCharacter(utf8::unchecked::next(place)))
            return Offence{static_cast<std::size_t>(character - begin), "a character that XML cannot hold"};
    }
    if (validEnd != end)
        return Offence{static_cast<std::size_t>(validEnd - begin), "not valid UTF-8"};
    return std::nullopt;
}

} // namespace Kv::XmlSyntax
