#include "windows/qtFloat.h"

#include "peers/qtLabel.h"
#include "peers/qtPeer.h"
#include "windows/qtFocusOrder.h"
#include "windows/qtFrontOrder.h"

#include <QApplication>
#include <QKeyEvent>
#include <QPainter>
#include <QStyle>

#include <algorithm>
#include <memory>

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

class Float final : public QtPeerOf<NtFloat, QtFloat>
{
public:
    Float(QWidget* parent, std::string const& name, NtFloatListener& listener) : QtPeerOf(parent, name, 0, listener) {}

    void raise() override
    {
        if (QtFloat* const native = getNative())
            QtFrontOrder::getInstance().bringToFront(*native);
    }

    void focusFirst() override { focusFirstInContent(); }

    void resumeKeyboard() override
    {
        if (QtFloat* const native = getNative())
            native->resumeKeyboard();
    }

    void setContentSize(int width, int height) override
    {
        if (QtFloat* const native = getNative())
            QtGuard::getInstance().carry([&] { native->setContentSize(width, height); });
    }

    void startAnew() override
    {
        if (QtFloat* const native = getNative())
            native->startAnew();
    }

    int getBarThickness() const override
    {
        QtFloat const* const native = getNative();
        return native ? native->style()->pixelMetric(QStyle::PM_ScrollBarExtent, nullptr, native) : 0;
    }

    QWidget* getContent() const override
    {
        QtFloat* const native = getNative();
        return native ? native->getContent() : nullptr;
    }
};

QtPeerKind<NtFloat, Float> registered;

} // namespace

QtFloat::QtFloat(QWidget* parent, QtListenerHandle<NtFloatListener> const& handle) : QWidget(parent), _handle(handle)
{
    setProperty(ntFloatMark, true);
    setAutoFillBackground(true);
    // Left and right are what descriptions say, whatever direction the user reads in.
    setLayoutDirection(Qt::LeftToRight);
    QtFrontOrder::getInstance().bringToFront(*this);
}

QtFloat::~QtFloat()
{
    QtFrontOrder::getInstance().remove(*this);
}

QtFloat* QtFloat::findAround(QWidget& widget)
{
    for (QWidget* around = &widget; around; around = around->parentWidget())
        if (auto* const floating = dynamic_cast<QtFloat*>(around))
            return floating;
    return nullptr;
}

QWidget* QtFloat::getContent()
{
    if (!_hasContent)
        makeContent();
    return _area ? _area->widget() : nullptr;
}

void QtFloat::makeContent()
{
    delete _area;
    delete _edge;
    auto area = std::make_unique<QtContentArea>(this, [handle = _handle](int width, int height)
                                                { return handle.tell(&NtFloatListener::onResized, width, height); });
    area->setWidget(new QWidget);
    area->widget()->hide();
    auto edge = std::make_unique<Edge>(this);
    _area = area.get();
    _edge = edge.get();
    // From here on the float owns both.
    static_cast<void>(area.release());
    static_cast<void>(edge.release());
    _hasContent = true;
    _area->setGeometry(rect());
    _area->show();
    _edge->setGeometry(rect());
    _edge->show();
}

void QtFloat::setContentSize(int width, int height)
{
    if (!_area)
        return;
    QPointer<QWidget> const content(_area->widget());
    _area->setContentSize(width, height);
    if (content)
        content->show();
}

void QtFloat::pin(QWidget& widget)
{
    widget.setParent(this);
    widget.show();
    if (_area)
        _area->setCover(widget);
    if (_edge)
        _edge->raise();
    if (auto* const title = dynamic_cast<QtLabel*>(&widget))
        title->makeTitle();
}

void QtFloat::askIntoView(QWidget const& widget) const
{
    QWidget const* const room = parentWidget();
    // A script can have taken either out of its place.
    if (!room || !isAncestorOf(&widget))
        return;
    // A move does not bring into sight what is scrolled away.
    QRect const seen = rect().intersected({widget.mapTo(this, QPoint(0, 0)), widget.size()}).translated(pos());
    int const right = getShift(seen.x(), seen.width(), room->width());
    int const down = getShift(seen.y(), seen.height(), room->height());
    if (right != 0 || down != 0)
        _handle.tell(&NtFloatListener::onMoveWanted, right, down);
}

void QtFloat::resumeKeyboard()
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

void QtFloat::showEvent(QShowEvent* event)
{
    QWidget::showEvent(event);
    QtFrontOrder::getInstance().cutHoles();
    if (!event->spontaneous() && _area)
        _area->tellRoom();
}

void QtFloat::hideEvent(QHideEvent* event)
{
    QWidget::hideEvent(event);
    QtFrontOrder::getInstance().cutHoles();
    if (event->spontaneous())
        return;
    if (_area)
        _area->forgetRoom();
    QtFrontOrder::getInstance().settleKeyboard(*window());
}

void QtFloat::moveEvent(QMoveEvent* event)
{
    QWidget::moveEvent(event);
    QtFrontOrder::getInstance().cutHoles();
}

void QtFloat::resizeEvent(QResizeEvent* event)
{
    QWidget::resizeEvent(event);
    QtFrontOrder::getInstance().cutHoles();
    if (_area)
        _area->fill(rect());
    if (_edge)
        _edge->setGeometry(rect());
}

void QtFloat::keyPressEvent(QKeyEvent* event)
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

} // namespace Kv
