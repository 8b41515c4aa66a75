#pragma once

#include "ntPeers.h"
#include "peers/qtLabelWidget.h"
#include "peers/qtPeer.h"

namespace Kv
{

/// The alignment as the toolkit has it, centred from bottom to top.
Qt::Alignment toQtAlignment(NtAlign align);

/// Text as it is, without markup or shortcuts.
class QtLabel final : public QtPeer<NtLabel, QtLabelWidget>
{
public:
    /// `parent`, which owns the widget natively, can be null.
    QtLabel(QWidget* parent, std::string const& name);

    void setText(std::string const& text) override;
    void setAlign(NtAlign align) override;
};

} // namespace Kv
