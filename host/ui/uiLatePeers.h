#pragma once

#include <list>

namespace Kv
{

class UiMoveContainer;

/// The floating containers that stand on the screen with nothing in them yet: the native peers of their widgets are
/// made with the next turn of the loop, before anything is painted, or as soon as somebody needs one. A container that
/// goes until then has cost little.
class UiLatePeers
{
public:
    using Place = std::list<UiMoveContainer*>::iterator;

    static UiLatePeers& getInstance();

    /// Borrowed until it is taken out.
    Place add(UiMoveContainer& container);
    void remove(Place place);

    /// Takes the one at that place out, to be put back to the end where it could not be filled. Neither can fail.
    std::list<UiMoveContainer*> take(Place place);
    Place putBack(std::list<UiMoveContainer*>& taken);

    /// Fills all containers.
    void makeAll();

private:
    std::list<UiMoveContainer*> _waiting;
    bool _turnIsAwaited = false;
};

} // namespace Kv
