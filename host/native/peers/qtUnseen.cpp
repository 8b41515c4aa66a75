#include "peers/qtUnseen.h"

namespace Kv
{

bool isInSight(QWidget const& widget)
{
    QRect seen = widget.rect();
    for (QWidget const* inner = &widget; !seen.isEmpty() && !inner->isWindow() && inner->parentWidget();
         inner = inner->parentWidget())
        seen = seen.translated(inner->pos()).intersected(inner->parentWidget()->rect());
    return !seen.isEmpty();
}

QtUnseen::QtUnseen(QWidget& widget) : _widget(widget.updatesEnabled() && !isInSight(widget) ? &widget : nullptr)
{
    // Of Qt's own ways to say so, one asks at the end.
    if (_widget)
        _widget->setAttribute(Qt::WA_UpdatesDisabled);
}

QtUnseen::~QtUnseen()
{
    if (_widget)
        _widget->setAttribute(Qt::WA_UpdatesDisabled, false);
}

} // namespace Kv
