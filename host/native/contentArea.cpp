#include "native/contentArea.h"

#include "native/captions.h"

#include <QPointer>

#include <utility>

namespace Kv
{

namespace
{

/// How often a layout may make scroll bars come and go before it is left as it is.
constexpr int maxRounds = 4;

} // namespace

ContentArea::ContentArea(QWidget* parent, std::function<void(int, int)> onRoom)
    : QScrollArea(parent), _onRoom(std::move(onRoom))
{
    setFrameShape(QFrame::NoFrame);
    // Tab stops at widgets only.
    setFocusPolicy(Qt::NoFocus);
}

void ContentArea::tellRoom()
{
    // Laying out can bring scroll bars, and these change the room again: that is told when the first is done.
    if (_telling || !isVisible())
        return;
    _telling = true;
    QPointer<QWidget> const alive(this);
    for (int round = 0; round < maxRounds && _told != viewport()->size(); ++round)
    {
        _told = viewport()->size();
        _onRoom(_told.width(), _told.height());
        if (!alive)
            return;
    }
    _telling = false;
}

void ContentArea::setContentSize(int width, int height)
{
    if (!widget())
        return;
    widget()->resize(width, height);
    nameValuesIn(*widget());
}

void ContentArea::nameValuesSoon()
{
    if (!std::exchange(_naming, true))
        QMetaObject::invokeMethod(
            this,
            [this]
            {
                _naming = false;
                if (widget())
                    nameValuesIn(*widget());
            },
            Qt::QueuedConnection);
}

void ContentArea::resizeEvent(QResizeEvent* event)
{
    QScrollArea::resizeEvent(event);
    tellRoom();
}

} // namespace Kv
