#pragma once

#include "ntPeers.h"
#include "peers/qtListenerHandle.h"
#include "peers/qtPeer.h"

#include <QPushButton>

namespace Kv
{

/// Button that Space, Enter and a click press.
class QtPushButton final : public QtPeer<NtPushButton, QPushButton>
{
public:
    /// `parent`, which owns the widget natively, can be null. The listener is borrowed.
    QtPushButton(QWidget* parent, std::string const& name, NtPushButtonListener& listener);
    ~QtPushButton() override;

    void setText(std::string const& text) override;
    void setAlign(NtAlign align) override;

private:
    QtPushButton(QWidget* parent, std::string const& name, QtListenerHandle<NtPushButtonListener> const& handle);

    QtListenerHandle<NtPushButtonListener> _handle;
};

} // namespace Kv
