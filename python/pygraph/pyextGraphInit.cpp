#include <boost/python.hpp>

#include "pyGraph.h"
#include "pyModule.h"
#include "pyextGraphDocs.h"

namespace bp = boost::python;

namespace Kv::PyextGraph
{

namespace
{

bool isEqual(Graph const& graph, bp::object const& other)
{
    bp::extract<Graph const&> const otherGraph(other);
    return otherGraph.check() && graph.isSameGraph(otherGraph());
}

RCShdPtr<ManagedGraph> readComposition(OsFilePath const& path)
{
    return makeShd<ManagedGraph>(Graph::read(path));
}

void registerGraph()
{
    if (PyextInit::shareClass<Graph>("Graph"))
        return;
    bp::class_<Graph, RCShdPtr<ManagedGraph>, boost::noncopyable>("Graph", Docs::graph, bp::no_init)
        .def("getName", &Graph::getName, Docs::getName)
        .def("getPath", &Graph::getPath, Docs::getPath)
        .def("isWritable", &Graph::isWritable, Docs::isWritable)
        .def("getNodes", &Graph::getNodes, Docs::getNodes)
        .def("getNodeType", &Graph::getNodeType, Docs::getNodeType)
        .def("getNodeInputs", &Graph::getNodeInputs, Docs::getNodeInputs)
        .def("getNodeValues", &Graph::getNodeValues, Docs::getNodeValues)
        .def("setNodeValue", &Graph::setNodeValue, Docs::setNodeValue)
        .def("save", &Graph::save, Docs::save)
        .def("__eq__", &isEqual)
        .def("__hash__", &Graph::getHash)
        .def("__repr__", &Graph::describe);
}

void registerException()
{
    GraphError::initialize("graph", "GraphError");
    bp::register_exception_translator<GraphError>(&GraphError::exceptionTranslator);
}

void moduleBody()
{
    bp::docstring_options const options(true, false, false);
    registerGraph();
    registerException();
    bp::def("readComposition", &readComposition, bp::arg("path"), Docs::readComposition);
    bp::scope().attr("__doc__") = Docs::module;
}

} // namespace

} // namespace Kv::PyextGraph

extern "C" KV_API PyObject* PyInit_libKVpyextGraph()
{
    return Kv::PyextInit::initModule<&Kv::PyextGraph::moduleBody>("libKVpyextGraph");
}
