#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace Kv
{

/// The name of a file that is one of a numbered sequence: "frame.0001.exr" is "frame.", the number 1 in 4 digits, and
/// ".exr".
struct QtNumberedName
{
    std::string prefix;
    std::string suffix;
    int digits = 0;
    std::uint64_t number = 0;

    /// The last number of two digits or more that is no part of an extension such as ".mp42"; null where there is none.
    static std::optional<QtNumberedName> parse(std::string const& name);

    /// The same for all files of one sequence, and for no others.
    std::string getSequenceKey() const;

    /// The name of the sequence for a reader, as "frame.####.exr".
    std::string getPattern() const;

    /// Sorted numbers for a reader: "1-4, 7-10", and with more than a few gaps "1-100, 12 missing".
    static std::string describe(std::vector<std::uint64_t> const& numbers);
};

} // namespace Kv
