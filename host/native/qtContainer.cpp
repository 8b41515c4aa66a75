#include "native/qtContainer.h"

#include "native/qtFocusOrder.h"

namespace Kv
{

QtContainer::QtContainer(QWidget* parent, std::string const& name) : QtPeer(makeNative<QWidget>(parent), name, 0) {}

void QtContainer::focusFirst()
{
    QWidget* const native = getNative();
    if (!native)
        return;
    if (QWidget* const first = QtFocusOrder(*native).getFirst())
        QtFocusOrder::give(*first, Qt::TabFocusReason);
}

} // namespace Kv
