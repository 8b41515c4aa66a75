#pragma once

#include <boost/python/object.hpp>

#include "files/osFilePath.h"

#include <string>

namespace Kv::PyextUi
{

/// The text of a description file as it stands, up to its first zero byte. Throws `UiError` where the file cannot be
/// opened.
std::string readDescriptionFile(OsFilePath const& path);

/// The length that a Python sequence gives of itself.
int lengthOf(boost::python::object const& sequence);

} // namespace Kv::PyextUi
