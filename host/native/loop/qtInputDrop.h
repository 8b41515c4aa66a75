#pragma once

#include <QObject>
#include <QPointer>
#include <QWidget>

namespace Kv
{

/// While it lives, what the user does to a window and to the popups of its widgets is dropped, on whatever way it
/// comes.
class QtInputDrop final : public QObject
{
public:
    /// `window` is borrowed and may go first.
    explicit QtInputDrop(QWidget& window);

    /// Has all that is pending handled, but what the user did to that window. Where the display or the application
    /// object goes on the way, it ends there.
    static void flush(QWidget& window);

    bool isFor(QWidget const& window) const { return _window == &window; }

    bool eventFilter(QObject* receiver, QEvent* event) override;

private:
    bool isOfWindow(QObject const* receiver) const;

    QPointer<QWidget> _window;
};

} // namespace Kv
