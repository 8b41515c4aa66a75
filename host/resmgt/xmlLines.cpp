#include "resmgt/xmlLines.h"

#include "resmgt/xmlError.h"

#include <algorithm>

namespace Kv
{

XmlLines::XmlLines(std::string_view text) : _starts{0}
{
    for (std::size_t end = text.find_first_of("\r\n"); end != std::string_view::npos;
         end = text.find_first_of("\r\n", end + 1))
        if (text.substr(end, 2) != "\r\n")
            _starts.push_back(end + 1);
}

int XmlLines::getLine(std::size_t offset) const
{
    return static_cast<int>(std::upper_bound(_starts.begin(), _starts.end(), offset) - _starts.begin());
}

void XmlLines::fail(std::size_t offset, std::string const& words) const
{
    throw XmlError(__FILE__, __LINE__, getLine(offset), words);
}

} // namespace Kv
