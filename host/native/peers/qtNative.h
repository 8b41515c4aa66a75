#pragma once

#include "ntPeers.h"

#include <QPointer>
#include <QString>
#include <QWidget>

#include <memory>

#include <string>

namespace Kv
{

class QtPointerWatch;

/// Handle of a native widget. Owns the widget together with the widget's native parent: whichever goes first takes it
/// along, so it can be gone at any time, and then the handle does nothing. A widget of the application's is borrowed.
class QtNative
{
public:
    /// Room above and below the widget that keeps rows which touch from looking glued together.
    static constexpr int rowInset = 2;

    /// `widget` can be null. It gets the name, is displayed and has no cell yet. `inset` is left free above and below
    /// in the cell, where the widget is not too high for that.
    QtNative(QWidget* widget, std::string const& name, int inset);

    /// A widget of the application's, which keeps its name and its place.
    explicit QtNative(NtForeignWidget widget);
    QtNative(QtNative const&) = delete;
    QtNative& operator=(QtNative const&) = delete;
    ~QtNative();

    /// Borrowed; null when the widget is gone.
    QWidget* get() const;

    void setCell(int x, int y, int width, int height) const;
    void setDisplayed(bool displayed) const;
    void setEnabled(bool enabled) const;
    void setTooltip(std::string const& text) const;
    void raise() const;
    void setBackground(NtColor const& color) const;
    void setLineBelow(bool drawn);
    void setPointerListener(NtPointerListener& listener);
    void takeKeyboard() const;
    bool hasKeyboard() const;
    bool holdsValue() const;

private:
    QPointer<QWidget> _widget;
    int _inset = 0;
    bool _foreign = false;
    std::unique_ptr<QtPointerWatch> _pointerWatch;
    QPointer<QWidget> _line;
};

} // namespace Kv
