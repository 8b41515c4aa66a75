#pragma once

#include <ostream>

namespace Velmora
{

/// Writes a line for every package that is loaded, the modules for scripts among them, with its build information.
void writeBuildInfo(std::ostream& stream);

} // namespace Velmora
