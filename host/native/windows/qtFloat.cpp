#include "windows/qtFloat.h"

#include "windows/qtFloatStack.h"

#include <QStyle>

namespace Kv
{

QtFloat::QtFloat(QWidget* parent, std::string const& name, NtFloatListener& listener)
    : QtFloat(parent, name, QtListenerHandle<NtFloatListener>(listener))
{
}

QtFloat::QtFloat(QWidget* parent, std::string const& name, QtListenerHandle<NtFloatListener> const& handle)
    : QtPeer(makeNative<QtFloatWidget>(parent, handle), name, 0), _handle(handle)
{
}

QtFloat::~QtFloat()
{
    _handle.close();
}

void QtFloat::raise()
{
    if (QtFloatWidget* const native = getNative())
        QtFloatStack::getInstance().bringToFront(*native);
}

void QtFloat::resumeKeyboard()
{
    if (QtFloatWidget* const native = getNative())
        native->resumeKeyboard();
}

void QtFloat::setContentSize(int width, int height)
{
    if (QtFloatWidget* const native = getNative())
        native->setContentSize(width, height);
}

int QtFloat::getBarThickness() const
{
    QtFloatWidget const* const native = getNative();
    return native ? native->style()->pixelMetric(QStyle::PM_ScrollBarExtent, nullptr, native) : 0;
}

QWidget* QtFloat::getContent() const
{
    QtFloatWidget const* const native = getNative();
    return native ? native->getContent() : nullptr;
}

} // namespace Kv
