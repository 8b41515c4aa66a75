#pragma once

#include "ntPlatform.h"
#include "start/qtApplication.h"

#include <QPointer>
#include <QWidget>

#include <memory>
#include <string>

namespace Kv
{

/// The window system by way of Qt.
class QtPlatform final : public NtPlatform
{
public:
    QtPlatform();

    void setScriptHook(NtScriptHook* hook) override;
    float measureText(std::string const& text) override;
    bool hasDisplay() override;
    GeVector2<int> getScreenSize() override;
    void setCursor(NtCursor cursor) override;

    std::unique_ptr<NtWindow> createWindow(std::string const& name, std::string const& title,
                                           std::string const& contentName, GeRectangle<int> const& frame,
                                           NtWindow* owner, NtWindowListener& listener) override;
    std::unique_ptr<NtMainWindow> adoptWindow(NtForeignWidget window, std::function<void(bool)> enableOwn,
                                              NtWindowListener& listener) override;
    std::unique_ptr<NtContainer> adoptContainer(NtForeignWidget widget, NtPlaceListener& listener) override;

    void callNextTurn(std::function<void()> call) override;
    void runLoop(bool const volatile* until, bool volatile* end) override;
    bool isLoopOver() override;
    int runApplication(std::function<void()> lastAct) override;
    void callScript(std::function<void()> const& call) override;
    void actForScript(std::function<void()> const& call) override;
    void endLoop() override;
    void interruptLoop() override;
    void closeLoops() override;
    void destroyWindows() override;
    void observe(std::unordered_set<void const*>& objects, std::function<void(void const*)> const& onGone) override;

private:
    std::unique_ptr<NtPeer> createPeer(std::type_index face, NtContainer& parent, std::string const& name,
                                       void* listener) override;
    [[noreturn]] void refuseLoop();

    QtApplication _application;
    /// The application's window.
    QPointer<QWidget> _adopted;

    /// The application that has our busy cursor, if one has.
    QPointer<QCoreApplication> _busyApplication;
    bool _closed = false;
    int _refusedLoops = 0;
};

} // namespace Kv

/// The entry that `ntPlatformEntry` names.
extern "C" __attribute__((visibility("default"))) Kv::NtPlatform& kvNativePlatform();
