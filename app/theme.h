#pragma once

#include <QColor>

namespace Velmora
{

/// Gives the application its colours: greys without a hue, which do not tinge what is judged by the eye. Of what is
/// selected, and of the frames around lists and texts, only those that have the keyboard are bright.
void applyTheme();

/// The colour of a text that tells of an error.
QColor getErrorColor();

} // namespace Velmora
