#pragma once

#include <QIcon>

namespace Kv
{

/// The icon of our windows in title bars and lists of windows: two nodes that lead into a third, on a ground of its
/// own, so that it is seen on light and on dark. Needs the application, which keeps it from the first call on.
QIcon getWindowIcon();

} // namespace Kv
