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

private:
    class Switch
    {
    public:
        Switch(Switch const&) = delete;
        Switch& operator=(Switch const&) = delete;

    protected:
        explicit Switch(bool turn);
        ~Switch();

    private:
        bool _wasTurn;
    };

public:
    /// Qt has its turn for as long as one lives.
    struct Turn : private Switch
    {
        Turn() : Switch(true) {}
    };

    /// In the midst of a turn, scripts have theirs.
    struct Pause : private Switch
    {
        Pause() : Switch(false) {}
    };
};

} // namespace Kv
