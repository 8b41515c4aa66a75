#include "snItem.h"

namespace Kv
{

SnItem::~SnItem() = default;

} // namespace Kv
