#include "wsThread.h"

#include "exBase.h"

#include <atomic>
#include <thread>

namespace Kv
{

namespace
{

std::atomic<std::thread::id>& uiThread()
{
    static std::atomic<std::thread::id> id{std::thread::id()};
    return id;
}

} // namespace

void WsThread::require(char const* what)
{
    std::thread::id const current = std::this_thread::get_id();
    std::thread::id expected;
    if (uiThread().compare_exchange_strong(expected, current) || expected == current)
        return;
    throw ExBase(__FILE__, __LINE__,
                 std::string(what) + ": the user interface belongs to the thread that used it first, and this call "
                                     "comes from another thread");
}

bool WsThread::isCurrent()
{
    std::thread::id const id = uiThread();
    return id == std::thread::id() || id == std::this_thread::get_id();
}

} // namespace Kv
