#pragma once

#include "geometry.h"
#include "kvExport.h"

namespace Kv
{

/// The screen that new windows go to.
class KV_API WsScreen
{
public:
    static WsScreen& getInstance();

    /// Width and height in pixels. Where there is no display, those of a stand-in.
    GeVector2<int> getSize() const;
};

} // namespace Kv
