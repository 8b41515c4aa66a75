#include "files/osFilePath.h"

#include "exBase.h"
#include "text/liString.h"

#include <system_error>
#include <utility>
#include <vector>

namespace Kv
{

namespace
{

namespace fs = std::filesystem;

/// As many links as the system itself follows.
constexpr int maximumLinks = 40;

/// The components still to be walked, the next one last.
using Components = std::vector<fs::path>;

void pushComponents(Components& components, fs::path const& path)
{
    std::vector<fs::path> const parts(path.begin(), path.end());
    components.insert(components.end(), parts.rbegin(), parts.rend());
}

fs::path getWorkingFolder(fs::path const& path)
{
    std::error_code error;
    fs::path folder = fs::current_path(error);
    if (error)
        throw ExBase(__FILE__, __LINE__,
                     "Cannot tell where " + LiStringUtil::getPrintablePath(path.native()) +
                         " is: there is no current folder: " + error.message());
    return folder;
}

/// Nothing where `path` is no link, or is nothing that could be reached.
fs::path readLink(fs::path const& path)
{
    std::error_code error;
    fs::path target = fs::read_symlink(path, error);
    // A link that were taken for a file would be replaced.
    if (error == std::errc::io_error || error == std::errc::not_enough_memory)
        throw ExBase(__FILE__, __LINE__,
                     "Cannot tell where " + LiStringUtil::getPrintablePath(path.native()) + " is: " + error.message());
    return target;
}

} // namespace

OsFilePath::OsFilePath() = default;

OsFilePath::OsFilePath(OsFilePath const&) = default;

OsFilePath::OsFilePath(OsFilePath&&) noexcept = default;

OsFilePath& OsFilePath::operator=(OsFilePath const&) = default;

OsFilePath& OsFilePath::operator=(OsFilePath&&) noexcept = default;

OsFilePath::~OsFilePath() = default;

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

OsFilePath OsFilePath::getCanonical() const
{
    fs::path canonical = _path.is_absolute() ? "/" : getWorkingFolder(_path);
    Components components;
    pushComponents(components, _path);
    int linkCount = 0;
    while (!components.empty())
    {
        fs::path const component = std::move(components.back());
        components.pop_back();
        if (component.empty() || component == ".")
            continue;
        if (component.is_absolute())
            canonical = "/";
        else if (component == "..")
            canonical = canonical.parent_path();
        else if (fs::path const target = readLink(canonical / component); !target.empty() && linkCount++ < maximumLinks)
            pushComponents(components, target);
        else
            canonical /= component;
    }
    return OsFilePath(canonical.native());
}

OsFilePath OsFilePath::getFolder() const
{
    return OsFilePath(_path.has_parent_path() ? _path.parent_path().native() : std::string("."));
}

std::string OsFilePath::getFileName() const
{
    return _path.filename().native();
}

} // namespace Kv
