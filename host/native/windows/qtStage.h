#pragma once

#include "loop/qtGuard.h"

#include <QWidget>

namespace Kv
{

/// A window or a floating container, with whose widgets the toolkit can be busy: knows when it was made.
class QtStage
{
public:
    QtStage() = default;
    QtStage(QtStage const&) = delete;
    QtStage& operator=(QtStage const&) = delete;
    virtual ~QtStage() = default;

    /// When the stage that a widget stands on, or is, was made.
    static QtGuard::Moment findBirth(QWidget const& widget);

private:
    QtGuard::Moment _birth = QtGuard::getInstance().getMoment();
};

} // namespace Kv
