#include "uiLatePeers.h"

#include "ntPlatform.h"
#include "uiMoveContainer.h"
#include "wsNative.h"

#include <utility>

namespace Kv
{

UiLatePeers& UiLatePeers::getInstance()
{
    // Never destroyed: containers go as late as the last objects of the interpreter do.
    static auto* const peers = new UiLatePeers;
    return *peers;
}

UiLatePeers::Place UiLatePeers::add(UiMoveContainer& container)
{
    if (!std::exchange(_turnIsAwaited, true))
        WsNative::getPlatform().callNextTurn(
            [this]
            {
                _turnIsAwaited = false;
                makeAll();
            });
    return _waiting.insert(_waiting.end(), &container);
}

void UiLatePeers::remove(Place place)
{
    _waiting.erase(place);
}

void UiLatePeers::makeAll()
{
    // One by one: what hears of a widget that comes can add and remove containers.
    while (!_waiting.empty())
        _waiting.front()->fill();
}

} // namespace Kv
