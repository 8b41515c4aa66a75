#pragma once

#include "kvExport.h"

#include <functional>
#include <optional>
#include <string>
#include <unordered_map>

namespace Kv
{

/// The tooltips of a resource, by the name of the widget. A resource is an XML file with the root `Tooltips` and in it
/// one element `Tooltip` a widget: its attribute `Widget` is the name, its content the text.
class KV_API UiResTable
{
public:
    /// Reads the resource of that name: a path, or a bare name, which is looked for in the application's folder of
    /// tooltips and then beside the script; each with the extension ".xml" and then without it. One that is not there
    /// gives an empty table. Throws an `ExBase` with file and line for a file that is no tooltip resource.
    static UiResTable load(std::string const& resourceName);

    /// `find` gives the folder of the script that runs; empty if there is none.
    static void setScriptFolder(std::function<std::string()> find);

    std::optional<std::string> findTooltip(std::string const& widgetName) const;

private:
    std::unordered_map<std::string, std::string> _tooltips;
};

} // namespace Kv
