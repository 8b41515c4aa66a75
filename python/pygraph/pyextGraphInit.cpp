#include <boost/python.hpp>

BOOST_PYTHON_MODULE(libKVpyextGraph)
{
    boost::python::scope().attr("__doc__") = "Quorvane Velmora internal graph extension module.";
}
