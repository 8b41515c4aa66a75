#pragma once

#include <QString>

#include <string>

namespace Kv
{

/// The text of the host, which is UTF-8, as one of the toolkit. Every character of it is kept, also what the toolkit
/// takes for a byte order mark where it stands first.
QString toQString(std::string const& text);

} // namespace Kv
