#pragma once

#include <QWidget>

namespace Kv
{

/// Calls each widget in `root` that holds a value by the label of its row: the one on its left, or as a check box often
/// has it, on its right.
void nameValuesIn(QWidget const& root);

} // namespace Kv
