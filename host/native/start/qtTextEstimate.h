#pragma once

#include <QString>

namespace Kv
{

/// Width in pixels that a text takes at most in a usual font of 12 pixels, for where there is no font to ask. Generous:
/// what is laid out by it has room for the text. Of several lines, the widest counts.
int estimateTextWidth(QString const& text);

} // namespace Kv
