#include "loop/qtSpareHandles.h"

#include "exBase.h"

#include <array>
#include <fcntl.h>
#include <unistd.h>
#include <utility>

namespace Kv
{

namespace
{

bool isTurn = true;

/// -1 for none.
std::array<int, 6> occupied{-1, -1, -1, -1, -1, -1};

/// Above the standard streams: one that is closed must not become another file.
int occupy()
{
    static int const any = open("/", O_PATH | O_CLOEXEC);
    return fcntl(any, F_DUPFD_CLOEXEC, STDERR_FILENO + 1);
}

void setTurn(bool turn)
{
    if (std::exchange(isTurn, turn) == turn)
        return;
    for (int& handle : occupied)
        if (!turn)
            handle = occupy();
        else if (handle >= 0)
            close(std::exchange(handle, -1));
}

} // namespace

void QtSpareHandles::reserve()
{
    setTurn(false);
}

void QtSpareHandles::require()
{
    int const handle = occupy();
    if (handle < 0)
        throw ExBase(__FILE__, __LINE__, "There are no file handles left: files have to be closed first");
    close(handle);
}

QtSpareHandles::Switch::Switch(bool turn) : _wasTurn(isTurn)
{
    setTurn(turn);
}

QtSpareHandles::Switch::~Switch()
{
    setTurn(_wasTurn);
}

} // namespace Kv
