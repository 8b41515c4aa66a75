#pragma once

#include "loop/qtGuard.h"
#include "ntPeer.h"

#include <atomic>
#include <memory>

namespace Kv
{

/// Way from a native widget to the listener of its peer. The peer and the widget have a copy each; once the peer has
/// closed it the widget is heard no more, however long it still lives. The listener is borrowed.
template <typename Listener> class QtListenerHandle
{
public:
    explicit QtListenerHandle(Listener& listener) : _listener(std::make_shared<std::atomic<Listener*>>(&listener)) {}

    void close() const { *_listener = nullptr; }

    /// Calls a member function of the listener, guarded. False if that has thrown.
    template <typename Method, typename... Args> bool tell(Method method, Args const&... args) const
    {
        // A copy: the widget that holds this one can go while the host hears of it.
        auto const shared = _listener;
        return QtGuard::getInstance().run(
            [&]
            {
                if (Listener* const listener = *shared)
                    (listener->*method)(args...);
            });
    }

private:
    std::shared_ptr<std::atomic<Listener*>> _listener;
};

/// A peer that has nothing to tell needs no way.
template <> class QtListenerHandle<NtNoListener>
{
public:
    explicit QtListenerHandle(NtNoListener&) {}

    void close() const {}
};

} // namespace Kv
