#include "native/qtNative.h"

#include "native/qtGuard.h"
#include "native/qtText.h"

#include <QCoreApplication>
#include <QTextDocument>

#include <algorithm>

namespace Kv
{

QtNative::QtNative(QWidget* widget, std::string const& name, int inset) : _widget(widget), _inset(inset)
{
    if (!_widget)
        return;
    QString const text = toQString(name);
    _widget->setObjectName(text);
    _widget->setAccessibleName(text);
    if (_widget->isWindow())
        return;
    _widget->setGeometry(0, 0, 0, 0);
    _widget->show();
}

QtNative::~QtNative()
{
    QtGuard::getInstance().destroy(_widget);
}

QWidget* QtNative::get() const
{
    return QCoreApplication::instance() ? _widget.data() : nullptr;
}

void QtNative::setCell(int x, int y, int width, int height) const
{
    QWidget* const widget = get();
    if (!widget)
        return;
    int const inset = widget->sizeHint().height() > height - 2 * _inset ? 0 : _inset;
    widget->setGeometry(x, y + inset, std::max(width, 0), std::max(height - 2 * inset, 0));
}

void QtNative::setDisplayed(bool displayed) const
{
    if (QWidget* const widget = get())
        widget->setVisible(displayed);
}

void QtNative::setEnabled(bool enabled) const
{
    if (QWidget* const widget = get())
        widget->setEnabled(enabled);
}

void QtNative::setTooltip(std::string const& text) const
{
    QString tip = toQString(text);
    if (Qt::mightBeRichText(tip))
        tip = Qt::convertFromPlainText(tip, Qt::WhiteSpaceNormal);
    if (QWidget* const widget = get())
        widget->setToolTip(tip);
}

void QtNative::raise() const
{
    if (QWidget* const widget = get())
        widget->raise();
}

} // namespace Kv
