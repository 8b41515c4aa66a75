#include "native/floatWidget.h"

#include "native/floatStack.h"
#include "native/labelWidget.h"
#include "native/qtFocusOrder.h"

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

FloatWidget::FloatWidget(QWidget* parent, QtListenerHandle<NtFloatListener> const& handle)
    : QWidget(parent), _handle(handle),
      _area(new ContentArea(this, [handle](int width, int height)
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
                    FloatStack::getInstance().bringToFront(*this);
            });
    // A timer would stay until it fires, also when this is gone.
    QMetaObject::invokeMethod(
        this, [handle] { handle.tell(&NtFloatListener::onFirstTurn); }, Qt::QueuedConnection);
    FloatStack::getInstance().bringToFront(*this);
}

FloatWidget::~FloatWidget()
{
    FloatStack::getInstance().remove(*this);
}

FloatWidget* FloatWidget::findAround(QWidget& widget)
{
    for (QWidget* around = &widget; around; around = around->parentWidget())
        if (auto* const floating = dynamic_cast<FloatWidget*>(around))
            return floating;
    return nullptr;
}

void FloatWidget::setContentSize(int width, int height)
{
    if (_area)
        _area->setContentSize(width, height);
}

void FloatWidget::pin(QWidget& widget)
{
    widget.setParent(this);
    widget.show();
    if (_area)
        _area->setCover(widget);
    if (_edge)
        _edge->raise();
    if (auto* const title = dynamic_cast<LabelWidget*>(&widget))
        title->makeTitle();
}

void FloatWidget::askIntoView(QWidget const& widget) const
{
    QWidget const* const room = parentWidget();
    // What is scrolled out of sight comes by no move.
    QRect const seen = rect().intersected({widget.mapTo(this, QPoint(0, 0)), widget.size()}).translated(pos());
    int const right = getShift(seen.x(), seen.width(), room->width());
    int const down = getShift(seen.y(), seen.height(), room->height());
    if (right != 0 || down != 0)
        _handle.tell(&NtFloatListener::onMoveWanted, right, down);
}

void FloatWidget::resumeKeyboard()
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

void FloatWidget::showEvent(QShowEvent* event)
{
    QWidget::showEvent(event);
    FloatStack::getInstance().cutHoles();
    if (!event->spontaneous() && _area)
        _area->tellRoom();
}

void FloatWidget::hideEvent(QHideEvent* event)
{
    QWidget::hideEvent(event);
    FloatStack::getInstance().cutHoles();
    if (event->spontaneous())
        return;
    if (_area)
        _area->forgetRoom();
    FloatStack::getInstance().settleKeyboard(*window());
}

void FloatWidget::moveEvent(QMoveEvent* event)
{
    QWidget::moveEvent(event);
    FloatStack::getInstance().cutHoles();
}

void FloatWidget::resizeEvent(QResizeEvent* event)
{
    QWidget::resizeEvent(event);
    FloatStack::getInstance().cutHoles();
    if (_area)
        _area->setGeometry(rect());
    if (_edge)
        _edge->setGeometry(rect());
}

void FloatWidget::keyPressEvent(QKeyEvent* event)
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

bool FloatWidget::focusNextPrevChild(bool next)
{
    return QtFocusOrder(*this).step(next);
}

} // namespace Kv
