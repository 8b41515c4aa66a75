#include "framework/fwCompositionListener.h"

namespace Kv
{

FwCompositionListener::~FwCompositionListener() = default;

} // namespace Kv
