#include "piBrowserSchemes.h"

namespace Kv
{

LiString const PiBrowserSchemes::FsScheme("fs");
LiString const PiBrowserSchemes::GantryScheme("gantry");
LiString const PiBrowserSchemes::PluginToolScheme("tool");
LiString const PiBrowserSchemes::PluginViewScheme("view");
LiString const PiBrowserSchemes::PicklistScheme("picklist");
LiString const PiBrowserSchemes::BookmarkScheme("bookmark");

} // namespace Kv
