#include "native/bottomLine.h"

#include <QEvent>

namespace Kv
{

BottomLine::BottomLine(QWidget* parent) : QFrame(parent)
{
    setFrameStyle(QFrame::HLine | QFrame::Plain);
    setAttribute(Qt::WA_TransparentForMouseEvents);
    parent->installEventFilter(this);
    follow();
    show();
}

bool BottomLine::eventFilter(QObject* watched, QEvent* event)
{
    if (event->type() == QEvent::Resize)
        follow();
    return QFrame::eventFilter(watched, event);
}

void BottomLine::follow()
{
    constexpr int thickness = 1;
    setGeometry(0, parentWidget()->height() - thickness, parentWidget()->width(), thickness);
}

} // namespace Kv
