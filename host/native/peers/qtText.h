#pragma once

#include "ntPeer.h"

#include <QString>

#include <string>

namespace Kv
{

/// The text of the host, which is UTF-8, as one of Qt. Every character of it is kept, also what Qt takes for a byte
/// order mark where it stands first.
QString toQString(std::string const& text);

/// The most characters of a text that Qt gets to draw: for more it takes a second.
inline constexpr qsizetype mostShown = 100'000;

/// The same for a text in one row that never scrolls: no screen shows more.
inline constexpr qsizetype mostInRow = 4096;

/// What Qt gets of a text to draw, and what is measured of it: the whole, or as many characters with an ellipsis at the
/// end. Who has to tell whether something is missing compares the sizes.
QString toShown(QString const& text, qsizetype most = mostShown);

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
