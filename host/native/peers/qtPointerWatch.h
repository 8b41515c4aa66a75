#pragma once

#include "ntPeer.h"
#include "peers/qtListenerHandle.h"

#include <QObject>
#include <QWidget>

class QMouseEvent;

namespace Kv
{

/// Tells a listener what the pointer does on a widget, and on those in it that do not want it themselves.
class QtPointerWatch final : public QObject
{
public:
    /// Both are borrowed; the widget may go first.
    QtPointerWatch(QWidget& widget, NtPointerListener& listener);
    ~QtPointerWatch() override;

    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    /// Calls a member function of the listener with the place of the event, and what it wants besides.
    template <typename Method, typename... Args>
    void tell(Method what, QWidget const& widget, QMouseEvent const& event, Args const&... args) const;

    QtListenerHandle<NtPointerListener> _handle;
};

} // namespace Kv
