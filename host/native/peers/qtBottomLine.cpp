#include "peers/qtBottomLine.h"

#include <QEvent>

namespace Kv
{

QtBottomLine::QtBottomLine(QWidget* parent) : QFrame(parent)
{
    setFrameStyle(QFrame::HLine | QFrame::Plain);
    setAttribute(Qt::WA_TransparentForMouseEvents);
    parent->installEventFilter(this);
    follow();
    show();
}

bool QtBottomLine::eventFilter(QObject* watched, QEvent* event)
{
    if (event->type() == QEvent::Resize)
        follow();
    return QFrame::eventFilter(watched, event);
}

void QtBottomLine::follow()
{
    constexpr int thickness = 1;
    setGeometry(0, parentWidget()->height() - thickness, parentWidget()->width(), thickness);
}

} // namespace Kv
