#pragma once

namespace Velmora
{

/// Gives the application its colours: greys without a hue, which do not tinge what is judged by the eye.
void applyTheme();

} // namespace Velmora
