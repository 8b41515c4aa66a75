#pragma once

#include "ntPlatform.h"
#include "start/qtApplication.h"

#include <QPointer>
#include <QWidget>

#include <memory>
#include <string>

namespace Kv
{

/// The window system by way of the toolkit.
class QtPlatform final : public NtPlatform
{
public:
    void setScriptHook(NtScriptHook* hook) override;
    float measureText(std::string const& text) override;
    GeVector2<int> getScreenSize() override;
    void setCursor(NtCursor cursor) override;

    std::unique_ptr<NtWindow> createWindow(std::string const& name, std::string const& title,
                                           std::string const& contentName, GeRectangle<int> const& frame,
                                           NtWindow* owner, NtWindowListener& listener) override;
    std::unique_ptr<NtMainWindow> adoptWindow(NtForeignWidget window, std::function<void(bool)> enableOwn,
                                              NtWindowListener& listener) override;
    std::unique_ptr<NtContainer> adoptContainer(NtForeignWidget widget, NtPlaceListener& listener) override;
    std::unique_ptr<NtContainer> createContainer(NtContainer& parent, std::string const& name) override;
    std::unique_ptr<NtFloat> createFloat(NtContainer& parent, std::string const& name,
                                         NtFloatListener& listener) override;
    std::unique_ptr<NtLabel> createLabel(NtContainer& parent, std::string const& name) override;
    std::unique_ptr<NtTextField> createTextField(NtContainer& parent, std::string const& name,
                                                 NtTextFieldListener& listener) override;
    std::unique_ptr<NtToggle> createToggle(NtContainer& parent, std::string const& name,
                                           NtToggleListener& listener) override;
    std::unique_ptr<NtMenu> createMenu(NtContainer& parent, std::string const& name, NtMenuListener& listener) override;
    std::unique_ptr<NtPushButton> createPushButton(NtContainer& parent, std::string const& name,
                                                   NtPushButtonListener& listener) override;
    std::unique_ptr<NtBrowser> createBrowser(NtContainer& parent, std::string const& name,
                                             NtBrowserListener& listener) override;

    void runLoop(bool const volatile* until, bool volatile* end) override;
    void endLoop() override;
    void interruptLoop() override;
    void closeLoops() override;
    void destroyWindows() override;
    bool observe(void const* object, std::function<void()> onGone) override;

private:
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
