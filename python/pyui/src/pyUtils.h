#pragma once

#include "files/osFilePath.h"

#include <string>

namespace Kv::PyextUi
{

/// The text of a description file as it stands, up to its first zero byte. Throws `UiError` where the file cannot be
/// opened.
std::string readDescriptionFile(OsFilePath const& path);

} // namespace Kv::PyextUi
