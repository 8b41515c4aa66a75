#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Kv
{

/// Where the lines of a text begin, to tell the line of a place in it.
class XmlLines
{
public:
    /// Lines end with LF, CR or both. The text is not kept.
    explicit XmlLines(std::string_view text);

    /// The line, from 1, of a byte.
    int getLine(std::size_t offset) const;

    /// Throws `XmlError` with the line of a byte.
    [[noreturn]] void fail(std::size_t offset, std::string const& words) const;

private:
    std::vector<std::size_t> _starts;
};

} // namespace Kv
