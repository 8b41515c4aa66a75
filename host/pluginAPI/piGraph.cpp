#include "piGraph.h"

namespace Kv
{

PiNodeController::~PiNodeController() = default;

PiNode::~PiNode() = default;

PiGraph::~PiGraph() = default;

} // namespace Kv
