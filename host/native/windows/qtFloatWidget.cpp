#include "windows/qtFloatWidget.h"

#include "peers/qtLabelWidget.h"
#include "windows/qtFloatStack.h"
#include "windows/qtFocusOrder.h"

#include <QApplication>
#include <QKeyEvent>
#include <QPainter>

#include <algorithm>

namespace Kv
{

namespace
{

/// Line around a float, above all that stands in it.
class Edge final : public QWidget
{
public:
    explicit Edge(QWidget* parent) : QWidget(parent) { setAttribute(Qt::WA_TransparentForMouseEvents); }

protected:
    void paintEvent(QPaintEvent*) override
    {
        QPainter painter(this);
        painter.setPen(palette().color(QPalette::Shadow));
        painter.drawRect(rect().adjusted(0, 0, -1, -1));
    }
};

/// By how much a span of `size` from `start` must move to lie within the room; its start wins where both ends cannot.
int getShift(int start, int size, int room)
{
    if (start + size > room)
        return std::max(room - size - start, -start);
    return std::max(-start, 0);
}

} // namespace

QtFloatWidget::QtFloatWidget(QWidget* parent, QtListenerHandle<NtFloatListener> const& handle)
    : QWidget(parent), _handle(handle),
      _area(new QtContentArea(this, [handle](int width, int height)
                              { handle.tell(&NtFloatListener::onResized, width, height); })),
      _edge(new Edge(this))
{
    setAutoFillBackground(true);
    // Of no size of its own: that comes with the content.
    _area->setWidget(new QWidget);
    // Who is given the keyboard wants to be seen.
    connect(qApp, &QApplication::focusChanged, this,
            [this](QWidget* from, QWidget* to)
            {
                if (to && isAncestorOf(to) && !(from && isAncestorOf(from)))
                    QtFloatStack::getInstance().bringToFront(*this);
            });
    // A timer would stay until it fires, also when this is gone.
    QMetaObject::invokeMethod(
        this, [handle] { handle.tell(&NtFloatListener::onFirstTurn); }, Qt::QueuedConnection);
    QtFloatStack::getInstance().bringToFront(*this);
}

QtFloatWidget::~QtFloatWidget()
{
    QtFloatStack::getInstance().remove(*this);
}

QtFloatWidget* QtFloatWidget::findAround(QWidget& widget)
{
    for (QWidget* around = &widget; around; around = around->parentWidget())
        if (auto* const floating = dynamic_cast<QtFloatWidget*>(around))
            return floating;
    return nullptr;
}

void QtFloatWidget::setContentSize(int width, int height)
{
    if (_area)
        _area->setContentSize(width, height);
}

void QtFloatWidget::pin(QWidget& widget)
{
    widget.setParent(this);
    widget.show();
    if (_area)
        _area->setCover(widget);
    if (_edge)
        _edge->raise();
    if (auto* const title = dynamic_cast<QtLabelWidget*>(&widget))
        title->makeTitle();
}

void QtFloatWidget::askIntoView(QWidget const& widget) const
{
    QWidget const* const room = parentWidget();
    // What is scrolled out of sight comes by no move.
    QRect const seen = rect().intersected({widget.mapTo(this, QPoint(0, 0)), widget.size()}).translated(pos());
    int const right = getShift(seen.x(), seen.width(), room->width());
    int const down = getShift(seen.y(), seen.height(), room->height());
    if (right != 0 || down != 0)
        _handle.tell(&NtFloatListener::onMoveWanted, right, down);
}

void QtFloatWidget::resumeKeyboard()
{
    // Qt remembers that for every widget with others in it.
    QWidget* const last = focusWidget();
    if (last && last != this && QtFocusOrder::canHold(*last))
        last->setFocus(Qt::OtherFocusReason);
    else if (QWidget* const first = QtFocusOrder(*this).getFirst())
        QtFocusOrder::give(*first, Qt::TabFocusReason);
    else
        setFocus(Qt::OtherFocusReason);
}

void QtFloatWidget::showEvent(QShowEvent* event)
{
    QWidget::showEvent(event);
    QtFloatStack::getInstance().cutHoles();
    if (!event->spontaneous() && _area)
        _area->tellRoom();
}

void QtFloatWidget::hideEvent(QHideEvent* event)
{
    QWidget::hideEvent(event);
    QtFloatStack::getInstance().cutHoles();
    if (event->spontaneous())
        return;
    if (_area)
        _area->forgetRoom();
    QtFloatStack::getInstance().settleKeyboard(*window());
}

void QtFloatWidget::moveEvent(QMoveEvent* event)
{
    QWidget::moveEvent(event);
    QtFloatStack::getInstance().cutHoles();
}

void QtFloatWidget::resizeEvent(QResizeEvent* event)
{
    QWidget::resizeEvent(event);
    QtFloatStack::getInstance().cutHoles();
    if (_area)
        _area->setGeometry(rect());
    if (_edge)
        _edge->setGeometry(rect());
}

void QtFloatWidget::keyPressEvent(QKeyEvent* event)
{
    if (event->key() != Qt::Key_Escape)
    {
        QWidget::keyPressEvent(event);
        return;
    }
    event->accept();
    if (!event->isAutoRepeat())
        _handle.tell(&NtFloatListener::onEscape);
}

bool QtFloatWidget::focusNextPrevChild(bool next)
{
    return QtFocusOrder(*this).step(next);
}

} // namespace Kv
