#include "piCompositionGraphInterface.h"

namespace Kv
{

PiCompositionGraphInterface::~PiCompositionGraphInterface() = default;

} // namespace Kv
