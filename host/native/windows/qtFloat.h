#pragma once

#include "peers/qtHolder.h"
#include "peers/qtPeer.h"
#include "windows/qtFloatWidget.h"

namespace Kv
{

/// Floating container.
class QtFloat final : public QtPeer<NtFloat, QtFloatWidget>, public QtHolder
{
public:
    /// `parent`, which owns the widget natively, can be null. The listener is borrowed.
    QtFloat(QWidget* parent, std::string const& name, NtFloatListener& listener);
    ~QtFloat() override;

    void raise() override;
    void focusFirst() override { focusFirstInContent(); }
    void resumeKeyboard() override;
    void setContentSize(int width, int height) override;
    int getBarThickness() const override;
    QWidget* getContent() const override;

private:
    QtFloat(QWidget* parent, std::string const& name, QtListenerHandle<NtFloatListener> const& handle);

    QtListenerHandle<NtFloatListener> _handle;
};

} // namespace Kv
