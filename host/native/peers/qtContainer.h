#pragma once

#include "ntContainer.h"
#include "peers/qtPeer.h"

namespace Kv
{

/// Plain widget that holds other peers' widgets.
class QtContainer final : public QtPeerOf<NtContainer, QWidget>
{
public:
    QtContainer(QWidget* parent, std::string const& name, NtNoListener& nobody) : QtPeerOf(parent, name, 0, nobody) {}

    void focusFirst() override { focusFirstInContent(); }
};

} // namespace Kv
