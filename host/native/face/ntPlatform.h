#pragma once

#include "exBase.h"
#include "geometry.h"
#include "ntWindow.h"

#include <exception>
#include <functional>
#include <memory>
#include <string>
#include <typeindex>
#include <unordered_set>

namespace Kv
{

/// Shape of the pointer where a widget does not ask for one of its own.
enum class NtCursor
{
    Normal,
    Busy,
};

/// The part of the scripts' interpreter in the native loop. Installed by the library that knows it; without one the
/// loop runs native handlers alone.
class NtScriptHook
{
public:
    virtual ~NtScriptHook() = default;

    /// Takes the interpreter for this thread, and gives it back: a native event can arrive while nobody holds it.
    /// `before` is what `enter` has given.
    virtual int enter() noexcept = 0;
    virtual void leave(int before) noexcept = 0;

    /// The number of times that this thread has entered the interpreter from outside, and not left it yet. Whoever
    /// enters it counts: between two moments with the same number there is nothing of the interpreter on the stack.
    virtual int getDepth() noexcept = 0;

    /// To be called while an exception is handled: that exception, for `rethrow`, with the interpreter's own error
    /// taken off the interpreter, so that scripts can run in between.
    virtual std::exception_ptr capture() noexcept = 0;

    /// Throws a captured exception on, with the interpreter's error back in place.
    [[noreturn]] virtual void rethrow(std::exception_ptr const& error) = 0;

    /// Takes the error that is set off the interpreter, for `putErrorBack`. Null where there is none, or no interpreter
    /// in this thread.
    virtual std::exception_ptr takeError() noexcept = 0;
    virtual void putErrorBack(std::exception_ptr const& error) noexcept = 0;

    /// `later` came while `first` was still on its way out: keeps it visible to the script's author.
    virtual void addContext(std::exception_ptr const& first, std::exception_ptr const& later) noexcept = 0;

    /// Prints a captured exception that nobody will see otherwise.
    virtual void report(std::exception_ptr const& error) noexcept = 0;

    /// Runs what is pending for the interpreter, Ctrl-C for one, and throws what comes of it.
    virtual void checkSignals() = 0;

    /// Makes Ctrl-C pending for the interpreter.
    virtual void interrupt() noexcept = 0;

    /// Has this thread call the function once, as its last act in the interpreter. One function a thread; at the end of
    /// the process another thread may make the call.
    virtual void callAtThreadEnd(void (*call)()) noexcept = 0;
};

/// The one face of the window system. All of it is for the thread of the user interface, but that peers and windows may
/// be let go from any thread.
class NtPlatform
{
public:
    NtPlatform() = default;
    NtPlatform(NtPlatform const&) = delete;
    NtPlatform& operator=(NtPlatform const&) = delete;
    virtual ~NtPlatform() = default;

    /// Borrowed; null takes the hook away.
    virtual void setScriptHook(NtScriptHook* hook) = 0;

    /// Width in pixels of a text as a widget draws it in the default font, rounded up to whole pixels.
    virtual float measureText(std::string const& text) = 0;

    /// False once the display is gone: whoever paints or dispatches events then may end the process.
    virtual bool hasDisplay() = 0;

    /// Size of the screen in pixels.
    virtual GeVector2<int> getScreenSize() = 0;

    virtual void setCursor(NtCursor cursor) = 0;

    /// Makes a window, not yet shown, and its content peer of the name `contentName`. `frame` is where its content goes
    /// on the screen, in pixels, y growing upward; it is moved and made smaller as far as the screen asks for it, and
    /// larger by the scroll bar that this asks for.
    /// `owner`, which can be null, is the window that it stays above. Throws an `ExBase` that says why and what to set
    /// where windows cannot be shown.
    virtual std::unique_ptr<NtWindow> createWindow(std::string const& name, std::string const& title,
                                                   std::string const& contentName, GeRectangle<int> const& frame,
                                                   NtWindow* owner, NtWindowListener& listener) = 0;

    /// Takes the application's window as one of the host's: the whole of it is the content. `enableOwn` enables and
    /// disables what is the application's own in it. Of the listener only `onResized` is called. Throws as
    /// `createWindow` does.
    virtual std::unique_ptr<NtMainWindow> adoptWindow(NtForeignWidget window, std::function<void(bool)> enableOwn,
                                                      NtWindowListener& listener) = 0;

    /// Takes a widget of the application's window as a container, which stays where the application has it.
    virtual std::unique_ptr<NtContainer> adoptContainer(NtForeignWidget widget, NtPlaceListener& listener) = 0;

    /// Calls the function once, with the next turn of the loop. What it throws comes out of the innermost loop.
    virtual void callNextTurn(std::function<void()> call) = 0;

    /// Makes a peer of the kind that `Face` is, displayed and enabled, without a cell. The listener is borrowed and
    /// outlives the peer.
    template <typename Face>
    std::unique_ptr<Face> create(NtContainer& parent, std::string const& name, typename Face::Listener& listener)
    {
        return std::unique_ptr<Face>(dynamic_cast<Face*>(createPeer(typeid(Face), parent, name, &listener).release()));
    }

    /// Dispatches events until `*until` is true, however it came to be. What a handler throws ends the loop and is
    /// thrown on from here. When the application is asked to quit, `*end` is set to true. Loops nest.
    virtual void runLoop(bool const volatile* until, bool volatile* end) = 0;

    /// True where the innermost loop has been ended, and only the last events of its turn still come.
    virtual bool isLoopOver() = 0;

    /// Runs the application's own loop, in which those of dialogs nest, and gives its exit status. `lastAct`, which
    /// throws nothing and can be null, is called as soon as the display is gone; then an `ExBase` comes out of here and
    /// of the loops of this platform. Where a loop of somebody else's runs in them, the process ends.
    virtual int runApplication(std::function<void()> lastAct) = 0;

    /// Calls what runs a script in that loop.
    virtual void callScript(std::function<void()> const& call) = 0;

    /// Calls what has the window system act while a script runs.
    virtual void actForScript(std::function<void()> const& call) = 0;

    /// Ends the innermost loop by setting its `*end`; without a loop, nothing happens.
    virtual void endLoop() = 0;

    /// Runs what is pending for the interpreter now, before other people's functions are called; what comes of it is
    /// thrown out of the innermost loop. Without a loop, nothing happens.
    virtual void interruptLoop() = 0;

    /// The application closes: ends all loops, each by setting its `*end`. One that begins later throws an `ExBase`; a
    /// script that goes on trying is interrupted.
    virtual void closeLoops() = 0;

    /// Destroys the windows that are left, while scripts can still hear of it. They cannot be shown again.
    virtual void destroyWindows() = 0;

    /// Leaves of the addresses those of living objects of Qt that the application made, not a script. `onGone` is
    /// called with the address of each when it goes.
    virtual void observe(std::unordered_set<void const*>& objects, std::function<void(void const*)> const& onGone) = 0;

private:
    /// Makes a peer with that face; `listener` is a `Listener` of the face.
    virtual std::unique_ptr<NtPeer> createPeer(std::type_index face, NtContainer& parent, std::string const& name,
                                               void* listener) = 0;
};

/// Name of the function that libKVnative exports; gives the process's one platform, which lives as long as the process.
constexpr char const* ntPlatformEntry = "kvNativePlatform";
using NtPlatformEntry = NtPlatform& (*)();

} // namespace Kv
