#include "windows/qtAdoptedContainer.h"

#include <QEvent>
#include <QObject>
#include <QPointer>

#include <optional>

namespace Kv
{

/// Tells a listener where a widget stands in its window, whenever that changes.
class QtPlaceWatch final : public QObject
{
public:
    /// Both are borrowed; the widget may go first.
    QtPlaceWatch(QWidget& widget, NtPlaceListener& listener);
    ~QtPlaceWatch() override;

    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void tell();

    QtListenerHandle<NtPlaceListener> _handle;
    QPointer<QWidget> _widget;
    std::optional<GeRectangle<int>> _told;
};

QtPlaceWatch::QtPlaceWatch(QWidget& widget, NtPlaceListener& listener) : _handle(listener), _widget(&widget)
{
    // The widgets that hold this one move it too.
    for (QWidget* around = &widget; around; around = around->parentWidget())
        around->installEventFilter(this);
    tell();
}

QtPlaceWatch::~QtPlaceWatch()
{
    _handle.close();
}

bool QtPlaceWatch::eventFilter(QObject* watched, QEvent* event)
{
    if (event->type() == QEvent::Resize || event->type() == QEvent::Move || event->type() == QEvent::Show)
        tell();
    return QObject::eventFilter(watched, event);
}

void QtPlaceWatch::tell()
{
    if (!_widget)
        return;
    QPoint const corner = _widget->mapTo(_widget->window(), QPoint(0, 0));
    int const top = _widget->window()->height() - corner.y();
    GeRectangle<int> const place{corner.x(), corner.x() + _widget->width(), top - _widget->height(), top};
    if (_told == place)
        return;
    _told = place;
    _handle.tell(&NtPlaceListener::onPlaced, place);
}

QtAdoptedContainer::QtAdoptedContainer(NtForeignWidget widget) : QtPeer(widget) {}

QtAdoptedContainer::QtAdoptedContainer(NtForeignWidget widget, NtPlaceListener& listener) : QtPeer(widget)
{
    if (QWidget* const native = getNative())
        _placeWatch = std::make_unique<QtPlaceWatch>(*native, listener);
}

QtAdoptedContainer::~QtAdoptedContainer() = default;

} // namespace Kv
