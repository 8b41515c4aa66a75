#include "peers/qtPeer.h"

#include "loop/qtDisposal.h"
#include "peers/qtLongText.h"
#include "peers/qtPointerWatch.h"
#include "peers/qtText.h"
#include "peers/qtUnseen.h"
#include "start/qtApplication.h"
#include "windows/qtFloat.h"
#include "windows/qtFocusOrder.h"

#include <QCoreApplication>
#include <QEvent>
#include <QFrame>

#include <algorithm>
#include <deque>
#include <stdexcept>
#include <utility>

namespace Kv
{

namespace
{

/// Line along the bottom edge of the widget that it stands in, which owns it.
class BottomLine final : public QFrame
{
public:
    explicit BottomLine(QWidget* parent) : QFrame(parent)
    {
        setFrameStyle(QFrame::HLine | QFrame::Plain);
        setAttribute(Qt::WA_TransparentForMouseEvents);
        parent->installEventFilter(this);
        follow();
        show();
    }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override
    {
        if (event->type() == QEvent::Resize)
            follow();
        return QFrame::eventFilter(watched, event);
    }

private:
    void follow()
    {
        constexpr int thickness = 1;
        setGeometry(0, parentWidget()->height() - thickness, parentWidget()->width(), thickness);
    }
};

QColor getReadableOn(QColor const& ground)
{
    // Weighed as the eye sees them; the middle between black and white text lies well below the middle of the greys.
    double const light = 0.2126 * ground.redF() + 0.7152 * ground.greenF() + 0.0722 * ground.blueF();
    return light > 0.46 ? Qt::black : Qt::white;
}

QtPeerKinds::Kind const*& getKinds()
{
    static QtPeerKinds::Kind const* first = nullptr;
    return first;
}

/// The number of widgets in one that is shown again, beyond which it takes care that they do not cost their square.
constexpr int many = 100;

/// Lets a widget and those in it be painted again, all at once. Qt's own way would have each ask for it.
void resumeUpdates(QWidget& widget)
{
    widget.setAttribute(Qt::WA_UpdatesDisabled, false);
    for (QWidget* const inner : widget.findChildren<QWidget*>())
        inner->setAttribute(Qt::WA_UpdatesDisabled, false);
    if (isInSight(widget))
        widget.update();
}

/// Shows a widget that was hidden. Qt posts an event to each widget in it, to be painted on its own, for which each
/// looks at all its siblings for those that cover it. Until these events are through, nobody asks to be painted.
void showAgain(QWidget& widget)
{
    widget.setUpdatesEnabled(false);
    try
    {
        widget.show();
        QMetaObject::invokeMethod(
            &widget, [&widget] { resumeUpdates(widget); }, Qt::QueuedConnection);
    }
    catch (...)
    {
        resumeUpdates(widget);
        throw;
    }
}

} // namespace

QtPeer::QtPeer(std::unique_ptr<QWidget> widget, int inset) : _widget(widget.get()), _inset(inset)
{
    static_cast<void>(widget.release());
}

QtPeer::QtPeer(std::unique_ptr<QWidget> widget, std::string const& name, int inset) : QtPeer(std::move(widget), inset)
{
    if (!_widget)
        return;
    _widget->setObjectName(toQString(name));
    if (_widget->isWindow())
        return;
    _widget->setGeometry(0, 0, 0, 0);
    // In a parent that is not shown yet it comes with that.
    if (_widget->isHidden())
        _widget->show();
}

QtPeer::QtPeer(NtForeignWidget widget) : _widget(static_cast<QWidget*>(widget.widget)), _foreign(true) {}

QtPeer::~QtPeer()
{
    if (!_foreign)
        QtDisposal::destroy(_widget);
}

QWidget* QtPeer::getNative() const
{
    return QtApplication::isThere() ? _widget.data() : nullptr;
}

void QtPeer::setCell(int x, int y, int width, int height)
{
    QWidget* const widget = getNative();
    if (!widget || _foreign)
        return;
    bool const hasRoom = _inset > 0 && widget->sizeHint().height() <= height - 2 * _inset;
    int const inset = hasRoom ? _inset : 0;
    widget->setGeometry(x, y + inset, std::max(width, 0), std::max(height - 2 * inset, 0));
}

void QtPeer::setDisplayed(bool displayed)
{
    QtErrorAside const aside;
    QWidget* const widget = getNative();
    if (widget && displayed && widget->isHidden() &&
        (widget->findChildren<QWidget*>().size() > many || !isInSight(*widget)))
        showAgain(*widget);
    else if (widget)
        widget->setVisible(displayed);
}

void QtPeer::setEnabled(bool enabled)
{
    QtErrorAside const aside;
    QWidget* const widget = getNative();
    if (!widget)
        return;
    // What stands in it is drawn in another way too, and asks for itself.
    std::deque<QtUnseen> unseen;
    unseen.emplace_back(*widget);
    for (QWidget* const inner : widget->findChildren<QWidget*>())
        unseen.emplace_back(*inner);
    widget->setEnabled(enabled);
}

void QtPeer::setTooltip(std::string const& text)
{
    QWidget* const widget = getNative();
    if (!widget)
        return;
    QString const tip = toQString(text);
    widget->setToolTip(toTooltip(tip));
    widget->setAccessibleDescription(toShown(tip));
}

void QtPeer::raise()
{
    if (QWidget* const widget = getNative())
        widget->raise();
}

void QtPeer::setBackground(NtColor const& color)
{
    QWidget* const widget = getNative();
    if (!widget)
        return;
    QColor const ground = QColor::fromRgbF(color.red, color.green, color.blue);
    QPalette palette = widget->palette();
    palette.setColor(widget->backgroundRole(), ground);
    palette.setColor(widget->foregroundRole(), getReadableOn(ground));
    widget->setPalette(palette);
    widget->setAutoFillBackground(true);
}

void QtPeer::setLineBelow(bool drawn)
{
    QWidget* const widget = getNative();
    if (!widget)
        return;
    if (drawn && !_line)
        _line = new BottomLine(widget);
    else if (!drawn)
        QtDisposal::destroy(std::exchange(_line, nullptr));
}

void QtPeer::setPointerListener(NtPointerListener& listener)
{
    QWidget* const widget = getNative();
    if (!widget)
        return;
    _pointerWatch = std::make_unique<QtPointerWatch>(*widget, listener);
    QWidget* const around = widget->parentWidget();
    if (QtFloat* const floating = around ? QtFloat::findAround(*around) : nullptr)
        floating->pin(*widget);
}

void QtPeer::takeKeyboard()
{
    if (QWidget* const widget = getNative())
        widget->setFocus(Qt::OtherFocusReason);
}

bool QtPeer::hasKeyboard() const
{
    QWidget const* const widget = getNative();
    if (!widget)
        return false;
    QWidget const* const focused = widget->window()->focusWidget();
    return focused && (focused == widget || widget->isAncestorOf(focused));
}

bool QtPeer::holdsValue() const
{
    QWidget const* const widget = getNative();
    return widget && QtFocusOrder::holdsValue(*widget);
}

void QtPeer::focusFirstInContent() const
{
    QWidget const* const content = getContent();
    if (!content)
        return;
    if (QWidget* const first = QtFocusOrder(*content).getFirst())
        QtFocusOrder::give(*first, Qt::TabFocusReason);
}

void QtPeerKinds::add(Kind& kind)
{
    kind.next = std::exchange(getKinds(), &kind);
}

std::unique_ptr<NtPeer> QtPeerKinds::make(std::type_index face, QWidget* parent, std::string const& name,
                                          void* listener)
{
    for (Kind const* kind = getKinds(); kind; kind = kind->next)
        if (kind->face == face)
            return kind->make(parent, name, listener);
    throw std::logic_error(std::string("No native widget has the face ") + face.name());
}

} // namespace Kv
