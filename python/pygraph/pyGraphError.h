#pragma once

#include "kvExport.h"
#include "pyModError.h"

namespace Kv::PyextGraph
{

/// Stands for this module where a template asks which one.
class KV_API GraphModule;

} // namespace Kv::PyextGraph

namespace Kv::PyextInit
{

// One set of statics for all libraries.
extern template class KV_API ModError<PyextGraph::GraphModule>;

} // namespace Kv::PyextInit

namespace Kv::PyextGraph
{

/// What the module itself finds wrong. Scripts see it as `GraphError`.
using GraphError = PyextInit::ModError<GraphModule>;

} // namespace Kv::PyextGraph
