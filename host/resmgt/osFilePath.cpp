#include "resmgt/osFilePath.h"

#include "base/exBase.h"
#include "resmgt/liStringUtil.h"

namespace Kv
{

OsFilePath::OsFilePath(std::string const& path) : _path(path)
{
    std::size_t const zero = path.find('\0');
    if (zero != std::string::npos)
        throw ExBase(__FILE__, __LINE__, "A path cannot hold a zero byte: " + LiStringUtil::getPrintable(path, zero));
}

char const* OsFilePath::getChars() const
{
    return _path.c_str();
}

std::string OsFilePath::toString() const
{
    return _path.native();
}

bool OsFilePath::isEmpty() const
{
    return _path.empty();
}

} // namespace Kv
