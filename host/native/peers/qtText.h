#pragma once

#include "ntPeer.h"

#include <QString>

#include <string>

namespace Kv
{

/// The text of the host, which is UTF-8, as one of Qt. Every character of it is kept, also what Qt takes for a byte
/// order mark where it stands first.
QString toQString(std::string const& text);

/// A text for where Qt takes a lone ampersand for the mark of a shortcut: each stands for itself.
QString withoutShortcuts(QString text);

/// The alignment as Qt has it, centred from bottom to top.
Qt::Alignment toQtAlignment(NtAlign align);

/// Bytes of the file system for a reader: those that are no text, and characters that would break a line or are not to
/// be seen, stand as replacement characters.
QString toShownPath(std::string const& path);

/// The bytes of the file system that a text stands for.
std::string toPath(QString const& text);

} // namespace Kv
