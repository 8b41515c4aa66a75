#include "piNode.h"

namespace Kv
{

PiNode::~PiNode() = default;

} // namespace Kv
