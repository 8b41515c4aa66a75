#pragma once

#include <boost/python/errors.hpp>
#include <boost/python/extract.hpp>

#include "files/osFilePath.h"

#include <string>

namespace Kv::PyextUi
{

/// The text of a description file as it stands, up to its first zero byte. Throws `UiError` where the file cannot be
/// opened.
std::string readDescriptionFile(OsFilePath const& path);

/// An object as a list or a tuple, which it must be. One whose `__class__` raises passes for either with Boost.Python,
/// which leaves the error behind.
template <typename Sequence> Sequence castTo(boost::python::object const& object)
{
    Sequence sequence = boost::python::extract<Sequence>(object)();
    if (PyErr_Occurred())
        boost::python::throw_error_already_set();
    return sequence;
}

/// The length that a Python sequence gives of itself.
int lengthOf(boost::python::object const& sequence);

} // namespace Kv::PyextUi
