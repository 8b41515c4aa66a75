#include "base/inBuildInfo.h"

namespace Kv
{

InBuildInfo::~InBuildInfo() = default;

} // namespace Kv
