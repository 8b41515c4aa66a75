#include "uiResTable.h"

#include "files/osFile.h"
#include "xml/xmlDocument.h"
#include "xml/xmlError.h"

#include <cstdint>
#include <dlfcn.h>
#include <filesystem>
#include <utility>
#include <vector>

namespace Kv
{

namespace
{

namespace fs = std::filesystem;

/// The folder of resources that is installed in the same tree as the libraries.
fs::path installedFolder()
{
    static char const anchor = 0;
    Dl_info info{};
    dladdr(&anchor, &info);
    return fs::path(info.dli_fname).parent_path() / "../../share/velmora/tooltips";
}

std::function<std::string()>& scriptFolder()
{
    static std::function<std::string()> find = [] { return std::string(); };
    return find;
}

/// The places where a resource can lie, without the extension.
std::vector<fs::path> placesOf(fs::path const& name)
{
    if (name.has_parent_path())
        return {name};
    std::string const beside = scriptFolder()();
    std::vector<fs::path> places{installedFolder() / name};
    if (!beside.empty())
        places.push_back(fs::path(beside) / name);
    return places;
}

std::optional<fs::path> findFile(std::string const& resourceName)
{
    if (!resourceName.empty())
        for (fs::path const& place : placesOf(resourceName))
            for (char const* const extension : {".xml", ""})
            {
                fs::path const candidate = fs::path(place) += extension;
                std::error_code error;
                if (fs::is_regular_file(candidate, error))
                    return candidate;
            }
    return std::nullopt;
}

std::unordered_map<std::string, std::string> readTooltips(fs::path const& file)
{
    constexpr std::uint64_t maxSize = std::uint64_t(16) << 20;
    std::string const text = OsFile(OsFilePath(file.native())).read(maxSize);
    RCShdPtr<XmlElement> const root = XmlDocument(text).getRoot();
    if (!root || root->getName() != "Tooltips")
        throw XmlError(__FILE__, __LINE__, root ? root->getLine() : 1, "the root element is not \"Tooltips\"");
    std::unordered_map<std::string, std::string> tooltips;
    for (XmlElement const& element : root->getChildren())
    {
        if (element.getName() != "Tooltip" || !element.getChildren().empty() ||
            element.getAttributeNames() != std::vector<std::string>{"Widget"})
            throw XmlError(__FILE__, __LINE__, element.getLine(),
                           "\"" + element.getName() + "\" is no \"Tooltip\" with a \"Widget\" and a text");
        tooltips.emplace(element.getAttribute("Widget"), element.getText());
    }
    return tooltips;
}

} // namespace

UiResTable UiResTable::load(std::string const& resourceName)
{
    UiResTable table;
    if (std::optional<fs::path> const file = findFile(resourceName))
        try
        {
            table._tooltips = readTooltips(*file);
        }
        catch (XmlError const& error)
        {
            throw ExBase(__FILE__, __LINE__, "Tooltip resource " + file->string() + ": " + error.getReason());
        }
    return table;
}

void UiResTable::setScriptFolder(std::function<std::string()> find)
{
    scriptFolder() = std::move(find);
}

std::optional<std::string> UiResTable::findTooltip(std::string const& widgetName) const
{
    auto const tooltip = _tooltips.find(widgetName);
    return tooltip == _tooltips.end() ? std::nullopt : std::optional<std::string>(tooltip->second);
}

} // namespace Kv
