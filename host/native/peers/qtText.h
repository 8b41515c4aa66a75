#pragma once

#include <QString>

#include <string>

namespace Kv
{

/// The text of the host, which is UTF-8, as one of the toolkit. Every character of it is kept, also what the toolkit
/// takes for a byte order mark where it stands first.
QString toQString(std::string const& text);

/// Bytes of the file system for a reader: those that are no text, and characters that would break a line or are not to
/// be seen, stand as replacement characters.
QString toShownPath(std::string const& path);

/// The bytes of the file system that a text stands for.
std::string toPath(QString const& text);

} // namespace Kv
