#include "piNodeController.h"

namespace Kv
{

PiNodeController::~PiNodeController() = default;

} // namespace Kv
