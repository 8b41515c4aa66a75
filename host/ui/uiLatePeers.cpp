#include "uiLatePeers.h"

#include "ntPlatform.h"
#include "uiMoveContainer.h"
#include "wsNative.h"

#include <iterator>

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
    if (!_turnIsAwaited)
        WsNative::getPlatform().callNextTurn(
            [this]
            {
                _turnIsAwaited = false;
                makeAll();
            });
    _turnIsAwaited = true;
    return _waiting.insert(_waiting.end(), &container);
}

void UiLatePeers::remove(Place place)
{
    _waiting.erase(place);
}

std::list<UiMoveContainer*> UiLatePeers::take(Place place)
{
    std::list<UiMoveContainer*> taken;
    taken.splice(taken.end(), _waiting, place);
    return taken;
}

UiLatePeers::Place UiLatePeers::putBack(std::list<UiMoveContainer*>& taken)
{
    _waiting.splice(_waiting.end(), taken);
    return std::prev(_waiting.end());
}

void UiLatePeers::makeAll()
{
    // One by one: what hears of a widget that comes can add and remove containers.
    while (!_waiting.empty())
        _waiting.front()->fill();
}

} // namespace Kv
