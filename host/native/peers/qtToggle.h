#pragma once

#include "ntPeers.h"
#include "peers/qtListenerHandle.h"
#include "peers/qtPeer.h"

#include <QCheckBox>

namespace Kv
{

/// Check box without a text of its own; the whole cell takes the click.
class QtToggle final : public QtPeer<NtToggle, QCheckBox>
{
public:
    /// `parent`, which owns the widget natively, can be null. The listener is borrowed.
    QtToggle(QWidget* parent, std::string const& name, NtToggleListener& listener);
    ~QtToggle() override;

    void setState(bool state) override;

private:
    QtToggle(QWidget* parent, std::string const& name, QtListenerHandle<NtToggleListener> const& handle);

    QtListenerHandle<NtToggleListener> _handle;
};

} // namespace Kv
