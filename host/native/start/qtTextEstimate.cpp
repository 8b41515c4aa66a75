#include "start/qtTextEstimate.h"

#include <QList>

#include <algorithm>
#include <string_view>

namespace Kv
{

namespace
{

constexpr int wideAdvance = 14;
constexpr int capitalAdvance = 10;
constexpr int usualAdvance = 8;
constexpr int narrowAdvance = 5;
constexpr int tabAdvance = 80;

bool isIdeographic(char32_t point)
{
    return (point >= 0x1100 && point < 0x1200) || (point >= 0x2e80 && point < 0xd800) ||
           (point >= 0xf900 && point < 0xfb00) || (point >= 0xff00 && point < 0xff61) || point >= 0x1f000;
}

bool isOneOf(std::u32string_view points, char32_t point)
{
    return points.find(point) != std::u32string_view::npos;
}

int advanceOf(char32_t point)
{
    if (point == U'\t')
        return tabAdvance;
    if (QChar::isMark(point))
        return 0;
    if (isIdeographic(point) || isOneOf(U"MWmw@%", point))
        return wideAdvance;
    if (isOneOf(U"ijl.,:;'|! ", point))
        return narrowAdvance;
    return point < 0x80 && QChar::isLower(point) ? usualAdvance : capitalAdvance;
}

} // namespace

int estimateTextWidth(QString const& text)
{
    int widest = 0;
    int width = 0;
    for (uint const point : text.toUcs4())
    {
        width = point == U'\n' ? 0 : width + advanceOf(point);
        widest = std::max(widest, width);
    }
    return widest;
}

} // namespace Kv
