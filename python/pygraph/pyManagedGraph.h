#pragma once

#include "pyGraph.h"
#include "pyManagedObject.h"

#include <boost/python/pointee.hpp>

namespace Kv
{

extern template class KV_API PyManagedObject<RCShdPtr<PyextGraph::Graph>>;

/// What Python objects keep of a graph.
using ManagedGraph = PyManagedObject<RCShdPtr<PyextGraph::Graph>>;

/// The graph in a wrapper; null for a wrapper around none. A null pointer to a wrapper throws `ExNullPtr`.
inline PyextGraph::Graph* get_pointer(RCShdPtr<ManagedGraph> const& managed)
{
    return managed->getValue().get();
}

} // namespace Kv

namespace boost::python
{

template <> struct pointee<Kv::RCShdPtr<Kv::ManagedGraph>>
{
    using type = Kv::PyextGraph::Graph;
};

} // namespace boost::python
