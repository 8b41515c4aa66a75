#include "pyGraphError.h"

namespace Kv::PyextInit
{

template class ModError<PyextGraph::GraphModule>;

} // namespace Kv::PyextInit
