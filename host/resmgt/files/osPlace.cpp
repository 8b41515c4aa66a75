#include "files/osPlace.h"

#include "exBase.h"
#include "files/osAsync.h"

#include <cstdlib>
#include <filesystem>
#include <pwd.h>
#include <system_error>
#include <unistd.h>

namespace Kv
{

namespace
{

namespace fs = std::filesystem;

std::string getHome()
{
    char const* const home = std::getenv("HOME"); // NOLINT(concurrency-mt-unsafe): nobody here sets variables
    if (home && *home)
        return home;
    passwd const* const user = getpwuid(getuid()); // NOLINT(concurrency-mt-unsafe): on the user interface's thread
    return user ? user->pw_dir : "/";
}

fs::path expandHome(std::string const& path)
{
    bool const isHome = path == "~" || path.compare(0, 2, "~/") == 0;
    return isHome ? fs::path(getHome() + path.substr(1)) : fs::path(path);
}

[[noreturn]] void throwNone(fs::path const& path)
{
    throw ExBase(__FILE__, __LINE__, "There is no " + OsPlace::quote(path.native()));
}

/// The directory that ".." names in one, which is another than the one in front of it where that is a link.
fs::path getParent(fs::path const& directory)
{
    std::error_code error;
    if (!fs::is_directory(directory, error))
        throwNone(directory / "..");
    return (fs::is_symlink(directory, error) ? fs::canonical(directory) : directory).parent_path();
}

/// Without the slash that ends the path of a directory.
std::string trim(fs::path const& path)
{
    std::string text = path.native();
    while (text.size() > 1 && text.back() == '/')
        text.pop_back();
    return text;
}

/// Free of "." and "..", with the links that are no part of the way to a "..".
fs::path resolveDots(std::string const& path)
{
    if (path.find('\0') != std::string::npos)
        throw ExBase(__FILE__, __LINE__, "A path cannot hold a zero byte");
    fs::path absolute;
    for (fs::path const& component : fs::path(path))
    {
        if (component == "..")
            absolute = getParent(trim(absolute));
        else
            absolute /= component == "." ? fs::path() : component;
    }
    return absolute;
}

} // namespace

std::string OsPlace::complete(std::string const& path, std::string const& base)
{
    std::error_code error;
    fs::path const from = base.empty() ? fs::current_path(error) : fs::path(base);
    return from / expandHome(path);
}

OsPlace OsPlace::find(std::string const& path)
{
    fs::path const absolute = resolveDots(path);
    std::error_code error;
    fs::file_status const status = fs::status(absolute, error);
    if (status.type() == fs::file_type::not_found)
        throwNone(absolute);
    if (status.type() == fs::file_type::none)
        throw ExBase(__FILE__, __LINE__,
                     "Cannot look at " + OsPlace::quote(absolute.native()) + ": " + error.message());
    if (fs::is_directory(status))
        return {trim(absolute), ""};
    return {trim(absolute.parent_path()), absolute.filename().native()};
}

OsPlace OsPlace::findInTime(std::string const& path)
{
    auto const place = OsAsync::ask(path, [path] { return find(path); });
    return place ? *place : OsPlace{trim(fs::path(path).lexically_normal()), ""};
}

OsPlace OsPlace::findNew(std::string const& path)
{
    fs::path const absolute = resolveDots(path);
    std::error_code error;
    bool const isTaken = fs::status(absolute, error).type() != fs::file_type::not_found;
    if (isTaken || !absolute.has_filename() || !fs::is_directory(absolute.parent_path(), error))
        throwNone(absolute);
    return {trim(absolute.parent_path()), absolute.filename().native()};
}

std::string OsPlace::findNearest(std::string const& directory)
{
    std::error_code error;
    fs::path path = directory;
    while (!fs::is_directory(path, error) && path.has_relative_path())
        path = path.parent_path();
    return path.native();
}

std::string OsPlace::quote(std::string const& path)
{
    return "'" + path + "'";
}

std::string OsPlace::join(std::string const& directory, std::string const& name)
{
    return name.empty() ? directory : (fs::path(directory) / name).native();
}

} // namespace Kv
