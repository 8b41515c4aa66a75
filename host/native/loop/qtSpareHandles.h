#pragma once

namespace Kv
{

/// File handles that scripts do not get. Qt needs one now and then, for a window that has grown, and where there is
/// none it waits for ever or ends the process. So a few are occupied, and free while Qt has its turn.
class QtSpareHandles
{
public:
    /// Occupies them; until then Qt has its turn.
    static void reserve();

    /// Throws `ExBase` where Qt would have none in its turn either.
    static void require();

    /// Qt has its turn for as long as one lives.
    class Turn
    {
    public:
        Turn();
        Turn(Turn const&) = delete;
        Turn& operator=(Turn const&) = delete;
        ~Turn();

    private:
        bool _wasTurn;
    };

    /// In the midst of a turn, scripts have theirs.
    class Pause
    {
    public:
        Pause();
        Pause(Pause const&) = delete;
        Pause& operator=(Pause const&) = delete;
        ~Pause();

    private:
        bool _wasTurn;
    };
};

} // namespace Kv
