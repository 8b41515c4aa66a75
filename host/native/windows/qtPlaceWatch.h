#pragma once

#include "ntPeers.h"
#include "peers/qtListenerHandle.h"

#include <QObject>
#include <QPointer>
#include <QWidget>

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

} // namespace Kv
