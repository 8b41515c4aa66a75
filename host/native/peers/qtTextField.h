#pragma once

#include "ntPeers.h"
#include "peers/qtListenerHandle.h"
#include "peers/qtPeer.h"

#include <QLineEdit>

namespace Kv
{

/// One line of text that the user can edit. Enter ends the edit; losing the keyboard does not.
class QtTextField final : public QtPeer<NtTextField, QLineEdit>
{
public:
    /// `parent`, which owns the widget natively, can be null. The listener is borrowed.
    QtTextField(QWidget* parent, std::string const& name, NtTextFieldListener& listener);
    ~QtTextField() override;

    void setText(std::string const& text, bool cursorAtEnd) override;
    void setAlign(NtAlign align) override;

private:
    QtTextField(QWidget* parent, std::string const& name, QtListenerHandle<NtTextFieldListener> const& handle);

    QtListenerHandle<NtTextFieldListener> _handle;
};

} // namespace Kv
