#pragma once

#include "kvExport.h"
#include "text/liString.h"

namespace Kv
{

/// The kinds of entity that a browser can show, by the names that browsers know them by.
class KV_API PiBrowserSchemes
{
public:
    static LiString const FsScheme;
    static LiString const GantryScheme;
    static LiString const PluginToolScheme;
    static LiString const PluginViewScheme;
    static LiString const PicklistScheme;
    static LiString const BookmarkScheme;
};

} // namespace Kv
