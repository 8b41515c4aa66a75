#include "windows/qtContentArea.h"

#include "windows/qtCaptions.h"

#include <QAccessible>
#include <QPointer>
#include <QScrollBar>

#include <algorithm>
#include <utility>
#include <vector>

namespace Kv
{

namespace
{

/// Height of a row of a form, in pixels.
constexpr int rowHeight = 28;

/// Knows whether a screen reader is there, and has the widgets in all areas named when it comes.
class ScreenReader final : private QAccessible::ActivationObserver
{
public:
    static ScreenReader& getInstance()
    {
        // Never destroyed: areas go as late as the last objects of the interpreter do.
        static auto* const reader = new ScreenReader;
        return *reader;
    }

    bool isThere() const { return _isThere; }

    // A list of its own: in that of Qt a widget stays that Qt has failed to construct.
    void add(QtContentArea& area) { _areas.push_back(&area); }
    void remove(QtContentArea& area) { _areas.erase(std::remove(_areas.begin(), _areas.end(), &area), _areas.end()); }

private:
    ScreenReader() { QAccessible::installActivationObserver(this); }

    void accessibilityActiveChanged(bool active) override
    {
        _isThere = active;
        for (QtContentArea* const area : _areas)
            area->nameValuesSoon();
    }

    std::vector<QtContentArea*> _areas;
    bool _isThere = QAccessible::isActive();
};

} // namespace

QtContentArea::QtContentArea(QWidget* parent, std::function<bool(int, int)> onRoom)
    : QScrollArea(parent), _onRoom(std::move(onRoom))
{
    setFrameShape(QFrame::NoFrame);
    setBars(false, false);
    // Tab stops at widgets only.
    setFocusPolicy(Qt::NoFocus);
    connect(verticalScrollBar(), &QScrollBar::actionTriggered, this, [this](int action) { turnPage(action); });
    ScreenReader::getInstance().add(*this);
}

QtContentArea::~QtContentArea()
{
    ScreenReader::getInstance().remove(*this);
}

void QtContentArea::fill(QRect const& place)
{
    setGeometry(place);
    tellRoom();
}

void QtContentArea::tellRoom()
{
    // Laying out can bring scroll bars, and these change the room again: that is told when the first is done.
    if (!widget() || _telling)
        return;
    _telling = true;
    QPointer<QWidget> const alive(this);
    // A content that fits without a bar, but not with what it needs then, keeps the bar.
    for (bool mayLoseBars = true;;)
    {
        QSize const room = maximumViewportSize();
        bool const isFilled = std::exchange(_told, room) == room || _onRoom(room.width(), room.height());
        if (!alive)
            return;
        // What has failed is done anew with the next occasion.
        if (!isFilled)
            forgetRoom();
        if (!isFilled || !widget())
            break;
        bool const isWide = widget()->width() > room.width();
        bool const isHigh = widget()->height() > room.height();
        bool const hasBelow = horizontalScrollBarPolicy() == Qt::ScrollBarAlwaysOn;
        bool const hasBeside = verticalScrollBarPolicy() == Qt::ScrollBarAlwaysOn;
        bool const losesBars = (hasBelow && !isWide) || (hasBeside && !isHigh);
        bool const getsBars = (isWide && !hasBelow) || (isHigh && !hasBeside);
        if (!getsBars && !(losesBars && mayLoseBars))
            break;
        setBars(isWide || (hasBelow && !mayLoseBars), isHigh || (hasBeside && !mayLoseBars));
        mayLoseBars = mayLoseBars && !losesBars;
    }
    _telling = false;
}

void QtContentArea::setContentSize(int width, int height)
{
    if (!widget())
        return;
    widget()->resize(width, height);
    nameValuesSoon();
    if (isVisible())
        tellRoom();
}

void QtContentArea::noticeReaders()
{
    ScreenReader::getInstance();
}

void QtContentArea::nameValuesSoon()
{
    if (ScreenReader::getInstance().isThere() && !std::exchange(_naming, true))
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

void QtContentArea::setBars(bool below, bool beside)
{
    // Left to Qt, a bar comes with a later turn, when all in the content is on the screen and has to be placed again.
    auto const getPolicy = [](bool isThere) { return isThere ? Qt::ScrollBarAlwaysOn : Qt::ScrollBarAlwaysOff; };
    setHorizontalScrollBarPolicy(getPolicy(below));
    setVerticalScrollBarPolicy(getPolicy(beside));
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
