// Paths that are asked for, and names in a directory that is shown. The lines of the input are paths and names; in a
// name, which has no slash, one is no part of it but stands for the end of a folder's.

#include "fuzz.h"
#include "window.h"

#include "brBrowser.h"
#include "browser/qtDirListing.h"
#include "exBase.h"
#include "files/osPlace.h"
#include "snSelection.h"

#include <algorithm>
#include <set>
#include <string>
#include <vector>

using namespace Kv;
namespace fs = std::filesystem;

namespace
{

std::vector<std::string> split(std::string_view text)
{
    std::vector<std::string> lines;
    for (std::size_t begin = 0; begin <= text.size() && lines.size() < 64;)
    {
        std::size_t const end = std::min(text.find('\n', begin), text.size());
        lines.emplace_back(text.substr(begin, end - begin));
        begin = end + 1;
    }
    return lines;
}

/// A new, empty folder with those of the names in it that the file system takes. Gives the names of what is there.
std::set<std::string> makeEntries(fs::path const& folder, std::vector<std::string> const& names)
{
    fs::remove_all(folder);
    fs::create_directory(folder);
    for (std::string const& name : names)
    {
        bool const isFolder = !name.empty() && name.back() == '/';
        std::string const bare = name.substr(0, name.size() - (isFolder ? 1 : 0));
        if (bare.find('/') != std::string::npos || bare.find('\0') != std::string::npos)
            continue;
        std::error_code ignored;
        if (isFolder)
            fs::create_directory(folder / bare, ignored);
        else if (!fs::exists(folder / bare, ignored))
            std::ofstream(folder / bare) << 'x';
    }
    std::set<std::string> present;
    for (fs::directory_entry const& entry : fs::directory_iterator(folder))
        present.insert(entry.path().filename().string());
    return present;
}

void requireListing(fs::path const& folder, std::set<std::string> const& names, bool collapsed)
{
    QtDirListing::Options options;
    options.showsHidden = true;
    if (collapsed)
        options.collapses = [](std::string const&) { return true; };
    QtDirListing const listing(folder, options, false);
    std::size_t files = 0;
    std::set<std::string> listed;
    for (QtDirEntry const& entry : listing.getEntries())
    {
        Fuzz::require(names.count(entry.name) == 1, "what is listed is there");
        Fuzz::require(listed.insert(entry.name).second, "what is there is listed once");
        files += entry.isDirectory ? 1 : static_cast<std::size_t>(entry.size);
    }
    Fuzz::require(files == names.size(), "all that is there is listed");
    for (QtDirListing::Key const key : {QtDirListing::Name, QtDirListing::Size, QtDirListing::Modified})
        for (bool const descending : {false, true})
        {
            std::vector<int> rows = listing.sort(key, descending);
            std::sort(rows.begin(), rows.end());
            Fuzz::require(rows.size() == listing.getEntries().size() &&
                              std::adjacent_find(rows.begin(), rows.end()) == rows.end(),
                          "an order has each row once");
        }
}

/// Asks for a path as the browser's field does. It leads somewhere, or is refused in words.
void requirePlace(std::string const& path, std::string const& base)
{
    for (auto const find : {&OsPlace::find, &OsPlace::findNew})
        try
        {
            OsPlace const place = find(OsPlace::complete(path, base));
            Fuzz::require(fs::is_directory(place.directory), "a place is in a directory");
            Fuzz::require(place.name.find('/') == std::string::npos, "a name is one component");
        }
        catch (ExBase const& error)
        {
            Fuzz::require(error.getReason()[0] != '\0', "an error has words");
        }
    Fuzz::require(fs::is_directory(OsPlace::findNearest("/" + path)), "the nearest directory exists");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    static Fuzz::Folder const root;
    fs::path const folder = root.getPath() / "shown";
    std::vector<std::string> const lines = split(Fuzz::asText(data, size));
    std::set<std::string> const names = makeEntries(folder, lines);
    requireListing(folder, names, false);
    requireListing(folder, names, true);

    RCShdPtr<UiTopLevel> const window = Fuzz::makeWindow();
    RCShdPtr<BrBrowser> const browser = BrBrowser::create(window->getRootContainer(), "browser", nullptr);
    for (std::string const& name : names)
    {
        Fuzz::require(browser->setURL((folder / name).string(), HistoryEnum::None, UpdateEnum::AtOnce),
                      "the browser goes to what is there");
        std::string const there =
            fs::is_directory(folder / name) ? browser->getPath().toString() : browser->getInputFocusPath().toString();
        Fuzz::require(there == (folder / name).string(), "the browser shows what was asked for");
    }
    for (std::string const& line : lines)
    {
        requirePlace(line, folder.string());
        std::string const before = browser->getPath().toString();
        if (!browser->setURL(line, HistoryEnum::None, UpdateEnum::AtOnce))
            Fuzz::require(browser->getPath().toString() == before, "a refused path changes nothing");
    }
    return 0;
}
