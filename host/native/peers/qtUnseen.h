#pragma once

#include <QPointer>
#include <QWidget>

namespace Kv
{

/// True unless a widget is scrolled out of what can be seen of those around it.
bool isInSight(QWidget const& widget);

/// While this lives, a widget that is out of sight does not ask to be painted. It is when it comes into sight; until
/// then Qt would for each that asks look at all its siblings for those that cover it.
class QtUnseen
{
public:
    explicit QtUnseen(QWidget& widget);
    ~QtUnseen();
    QtUnseen(QtUnseen const&) = delete;
    QtUnseen& operator=(QtUnseen const&) = delete;

private:
    /// Null for one that may ask. A change can delete it.
    QPointer<QWidget> _widget;
};

} // namespace Kv
