#pragma once

#include "inputDoor.h"

#include <QPointer>
#include <QWidget>

#include <vector>

namespace Kv
{

/// The dialog that takes input, in a window of its own or floating in the application's, and what is in it.
class QtStage
{
public:
    /// Null where no dialog takes input.
    static QWidget* findDialog();

    static QString getTitle(QWidget const& dialog);

    /// Takes the widgets of the dialog for `get`, as the eye goes.
    std::vector<IdWidget> look();

    /// Throws an `ExBase` for a place that `look` did not give, or a widget that is gone.
    QWidget& get(std::size_t place) const;

private:
    std::vector<QPointer<QWidget>> _widgets;
};

} // namespace Kv
