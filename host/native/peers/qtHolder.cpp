#include "peers/qtHolder.h"

#include "windows/qtFocusOrder.h"

namespace Kv
{

void QtHolder::focusFirstInContent() const
{
    QWidget const* const content = getContent();
    if (!content)
        return;
    if (QWidget* const first = QtFocusOrder(*content).getFirst())
        QtFocusOrder::give(*first, Qt::TabFocusReason);
}

} // namespace Kv
