#include "windows/qtContentArea.h"

#include "windows/qtCaptions.h"

#include <QPointer>
#include <QScrollBar>

#include <algorithm>
#include <utility>

namespace Kv
{

namespace
{

/// The number of times that scroll bars may come and go before a layout is left as it is.
constexpr int maxRounds = 4;

/// Height of a row of a form, in pixels.
constexpr int rowHeight = 28;

} // namespace

QtContentArea::QtContentArea(QWidget* parent, std::function<void(int, int)> onRoom)
    : QScrollArea(parent), _onRoom(std::move(onRoom))
{
    setFrameShape(QFrame::NoFrame);
    // Tab stops at widgets only.
    setFocusPolicy(Qt::NoFocus);
    connect(verticalScrollBar(), &QScrollBar::actionTriggered, this, [this](int action) { turnPage(action); });
}

void QtContentArea::tellRoom()
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

void QtContentArea::setContentSize(int width, int height)
{
    if (!widget())
        return;
    widget()->resize(width, height);
    nameValuesSoon();
}

void QtContentArea::nameValuesSoon()
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

void QtContentArea::resizeEvent(QResizeEvent* event)
{
    QScrollArea::resizeEvent(event);
    tellRoom();
}

void QtContentArea::turnPage(int action)
{
    if (action != QScrollBar::SliderPageStepAdd && action != QScrollBar::SliderPageStepSub)
        return;
    // Qt has turned it by all that it shows of the content. What was covered, or a row that was cut off, would be
    // passed over.
    int const covered = _cover && !_cover->isHidden() ? _cover->height() : 0;
    QScrollBar& bar = *verticalScrollBar();
    int const step = std::max(bar.pageStep() - covered - rowHeight, bar.singleStep());
    bar.setSliderPosition(bar.value() + (action == QScrollBar::SliderPageStepAdd ? step : -step));
}

} // namespace Kv
