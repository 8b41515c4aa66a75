#include "base/inBuildInfo.h"

namespace Kv
{

InBuildInfo::InBuildInfo() = default;

InBuildInfo::~InBuildInfo() = default;

} // namespace Kv
