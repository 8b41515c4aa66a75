#pragma once

#include "piGraph.h"

#include <string>

namespace Kv
{

/// Writes compositions as `FwCompositionReader` reads them.
class FwCompositionWriter
{
public:
    /// The text of the whole file, which gives exactly the same nodes when it is read.
    static std::string write(PiGraph const& graph);
};

} // namespace Kv
