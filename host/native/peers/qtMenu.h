#pragma once

#include "ntPeers.h"
#include "peers/qtListenerHandle.h"
#include "peers/qtPeer.h"

#include <QComboBox>

namespace Kv
{

/// List of entries to pick one from; none may be selected.
class QtMenu final : public QtPeer<NtMenu, QComboBox>
{
public:
    /// `parent`, which owns the widget natively, can be null. The listener is borrowed.
    QtMenu(QWidget* parent, std::string const& name, NtMenuListener& listener);
    ~QtMenu() override;

    void removeAll() override;
    void append(std::string const& entry) override;
    void select(int index) override;
    void setAlign(NtAlign align) override;

private:
    QtMenu(QWidget* parent, std::string const& name, QtListenerHandle<NtMenuListener> const& handle);

    QtListenerHandle<NtMenuListener> _handle;
};

} // namespace Kv
