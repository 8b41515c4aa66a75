#pragma once

#include "ntPlatform.h"
#include "uiWidget.h"

#include <memory>

namespace Kv
{

/// Base of the kinds of widgets whose native peer has the face `Face`; hears of the user as the listener of that says.
template <typename Face> class UiPeeredWidget : public UiWidget, protected Face::Listener
{
protected:
    using UiWidget::UiWidget;

    /// The native peer, borrowed; null while there is none.
    Face* getPeer() const { return _native; }

    /// Shows the state of the widget on a new peer.
    virtual void showState(Face& peer) = 0;

    std::unique_ptr<NtPeer> createPeer(NtPlatform& platform, NtContainer& parent) final
    {
        std::unique_ptr<Face> peer = platform.create<Face>(parent, getName(), *this);
        showState(*peer);
        _native = peer.get();
        return peer;
    }

    void dropPeer() final
    {
        _native = nullptr;
        UiWidget::dropPeer();
    }

private:
    Face* _native = nullptr;
};

} // namespace Kv
