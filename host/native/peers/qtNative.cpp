#include "peers/qtNative.h"

#include "loop/qtGuard.h"
#include "peers/qtBottomLine.h"
#include "peers/qtLongText.h"
#include "peers/qtPeer.h"
#include "peers/qtPointerWatch.h"
#include "peers/qtText.h"
#include "windows/qtFloatWidget.h"
#include "windows/qtFocusOrder.h"

#include <QCoreApplication>

#include <algorithm>
#include <utility>

namespace Kv
{

namespace
{

QColor getReadableOn(QColor const& ground)
{
    // Weighed as the eye sees them; the middle between black and white text lies well below the middle of the greys.
    double const light = 0.2126 * ground.redF() + 0.7152 * ground.greenF() + 0.0722 * ground.blueF();
    return light > 0.46 ? Qt::black : Qt::white;
}

} // namespace

QtNative::QtNative(QWidget* widget, std::string const& name, int inset) : _widget(widget), _inset(inset)
{
    if (!_widget)
        return;
    _widget->setObjectName(toQString(name));
    if (_widget->isWindow())
        return;
    _widget->setGeometry(0, 0, 0, 0);
    _widget->show();
}

QtNative::QtNative(NtForeignWidget widget) : _widget(static_cast<QWidget*>(widget.widget)), _foreign(true) {}

QtNative::~QtNative()
{
    if (!_foreign)
        QtGuard::getInstance().destroy(_widget);
}

QWidget* QtNative::get() const
{
    return QCoreApplication::instance() ? _widget.data() : nullptr;
}

void QtNative::setCell(int x, int y, int width, int height) const
{
    QWidget* const widget = get();
    if (!widget || _foreign)
        return;
    int const inset = widget->sizeHint().height() > height - 2 * _inset ? 0 : _inset;
    widget->setGeometry(x, y + inset, std::max(width, 0), std::max(height - 2 * inset, 0));
}

void QtNative::setDisplayed(bool displayed) const
{
    QtErrorAside const aside;
    if (QWidget* const widget = get())
        widget->setVisible(displayed);
}

void QtNative::setEnabled(bool enabled) const
{
    QtErrorAside const aside;
    if (QWidget* const widget = get())
        widget->setEnabled(enabled);
}

void QtNative::setTooltip(std::string const& text) const
{
    QWidget* const widget = get();
    if (!widget)
        return;
    QString const tip = toQString(text);
    widget->setToolTip(toTooltip(tip));
    widget->setAccessibleDescription(tip);
}

void QtNative::raise() const
{
    if (QWidget* const widget = get())
        widget->raise();
}

void QtNative::setBackground(NtColor const& color) const
{
    QWidget* const widget = get();
    if (!widget)
        return;
    QColor const ground = QColor::fromRgbF(color.red, color.green, color.blue);
    QPalette palette = widget->palette();
    palette.setColor(widget->backgroundRole(), ground);
    palette.setColor(widget->foregroundRole(), getReadableOn(ground));
    widget->setPalette(palette);
    widget->setAutoFillBackground(true);
}

void QtNative::setLineBelow(bool drawn)
{
    QWidget* const widget = get();
    if (!widget)
        return;
    if (drawn && !_line)
        _line = makeNative<QtBottomLine>(widget);
    else if (!drawn)
        QtGuard::getInstance().destroy(std::exchange(_line, nullptr));
}

void QtNative::setPointerListener(NtPointerListener& listener)
{
    QWidget* const widget = get();
    if (!widget)
        return;
    _pointerWatch = std::make_unique<QtPointerWatch>(*widget, listener);
    QWidget* const around = widget->parentWidget();
    if (QtFloatWidget* const floating = around ? QtFloatWidget::findAround(*around) : nullptr)
        floating->pin(*widget);
}

void QtNative::takeKeyboard() const
{
    if (QWidget* const widget = get())
        widget->setFocus(Qt::OtherFocusReason);
}

bool QtNative::hasKeyboard() const
{
    QWidget const* const widget = get();
    if (!widget)
        return false;
    QWidget const* const holder = widget->window()->focusWidget();
    return holder && (holder == widget || widget->isAncestorOf(holder));
}

bool QtNative::holdsValue() const
{
    QWidget const* const widget = get();
    return widget && QtFocusOrder::holdsValue(*widget);
}

} // namespace Kv
