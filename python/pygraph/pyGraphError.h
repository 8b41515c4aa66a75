#pragma once

#include "pygraph/kvPyextGraphExport.h"
#include "pyinit/pyModError.h"

namespace Kv::PyextGraph
{

/// Stands for this module where a template asks which one.
class KVPYEXTGRAPH_API GraphModule;

} // namespace Kv::PyextGraph

namespace Kv::PyextInit
{

// One set of statics for all libraries.
extern template class KVPYEXTGRAPH_API ModError<PyextGraph::GraphModule>;

} // namespace Kv::PyextInit

namespace Kv::PyextGraph
{

/// What the module itself finds wrong. Scripts see it as `GraphError`.
using GraphError = PyextInit::ModError<GraphModule>;

} // namespace Kv::PyextGraph
