#include "piGraph.h"

namespace Kv
{

PiGraph::~PiGraph() = default;

} // namespace Kv
