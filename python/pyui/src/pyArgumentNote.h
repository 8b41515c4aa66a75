#pragma once

#include <boost/python/object.hpp>

#include <string>
#include <vector>

namespace Kv::PyextUi
{

/// Has a function of Boost.Python say in a note why it cannot be called with the arguments by name that it was given.
/// `parameters` are the names of its parameters in order, empty for those that go by place; without any all do.
void explainArguments(boost::python::object const& function, std::vector<std::string> const& parameters);

} // namespace Kv::PyextUi
