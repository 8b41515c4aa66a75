#pragma once

#include "peers/qtNative.h"

#include <string>

namespace Kv
{

/// What all peers share: `Face` is the peer's face to the host, `Widget` the toolkit's class that stands behind it.
template <typename Face, typename Widget> class QtPeer : public Face
{
public:
    void setCell(int x, int y, int width, int height) override { _native.setCell(x, y, width, height); }
    void setDisplayed(bool displayed) override { _native.setDisplayed(displayed); }
    void setEnabled(bool enabled) override { _native.setEnabled(enabled); }
    void setTooltip(std::string const& text) override { _native.setTooltip(text); }
    void raise() override { _native.raise(); }
    void setBackground(NtColor const& color) override { _native.setBackground(color); }
    void setLineBelow(bool drawn) override { _native.setLineBelow(drawn); }
    void setPointerListener(NtPointerListener& listener) override { _native.setPointerListener(listener); }
    void takeKeyboard() override { _native.takeKeyboard(); }
    bool hasKeyboard() const override { return _native.hasKeyboard(); }
    bool holdsValue() const override { return _native.holdsValue(); }

    /// Borrowed; null when the widget is gone.
    Widget* getNative() const { return static_cast<Widget*>(_native.get()); }

protected:
    QtPeer(Widget* widget, std::string const& name, int inset) : _native(widget, name, inset) {}
    explicit QtPeer(NtForeignWidget widget) : _native(widget) {}

private:
    QtNative _native;
};

/// A new native widget, owned by its native parent; null where that is gone.
template <typename Widget, typename... Args> Widget* makeNative(QWidget* parent, Args const&... args)
{
    return parent ? new Widget(parent, args...) : nullptr;
}

} // namespace Kv
