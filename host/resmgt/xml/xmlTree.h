#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace Kv
{

/// A document that has been read. The elements stand in the order in which they begin, so what is in one follows it.
struct XmlTree
{
    /// A stretch of `texts`.
    struct Stretch
    {
        std::uint32_t begin;
        std::uint32_t size;
    };

    struct Attribute
    {
        Stretch name;
        Stretch value;
    };

    struct Element
    {
        Stretch name;
        Stretch text;
        /// The attributes are those from the first up to the one at the end.
        std::uint32_t firstAttribute;
        std::uint32_t attributesEnd;
        /// The first element that is no longer in this one.
        std::uint32_t end;
        int line;
    };

    std::string_view get(Stretch stretch) const { return std::string_view(texts).substr(stretch.begin, stretch.size); }

    Stretch append(std::string_view text)
    {
        Stretch const stretch{static_cast<std::uint32_t>(texts.size()), static_cast<std::uint32_t>(text.size())};
        texts.append(text);
        return stretch;
    }

    std::string texts;
    std::vector<Attribute> attributes;
    std::vector<Element> elements;
};

} // namespace Kv
