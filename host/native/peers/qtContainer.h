#pragma once

#include "peers/qtHolder.h"
#include "peers/qtPeer.h"

namespace Kv
{

/// Plain widget that holds other peers' widgets.
class QtContainer final : public QtPeer<NtContainer, QWidget>, public QtHolder
{
public:
    /// `parent`, which owns the widget natively, can be null.
    QtContainer(QWidget* parent, std::string const& name);

    void focusFirst() override { focusFirstInContent(); }
    QWidget* getContent() const override { return getNative(); }
};

} // namespace Kv
