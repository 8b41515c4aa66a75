#include "xml/xmlError.h"

namespace Kv
{

XmlError::XmlError(char const* sourcePath, int sourceLine, int line, std::string const& words)
    : ExBase(sourcePath, sourceLine, line > 0 ? "line " + std::to_string(line) + ": " + words : words), _line(line)
{
}

int XmlError::getLine() const
{
    return _line;
}

ExBase* XmlError::clone() const
{
    return new XmlError(*this);
}

void XmlError::raise() const
{
    throw XmlError(*this);
}

} // namespace Kv
