#pragma once

#include "ntWindow.h"
#include "uiTopLevel.h"

#include <functional>

namespace Kv
{

/// The window of the application, which has made it with Qt itself. The host's containers float in it, and stand in the
/// panels that the application gives it.
class KV_API UiMainWindow : public UiTopLevel
{
public:
    /// `widget` is the window. `enableOwn` enables and disables what is the application's own in it. Throws an `ExBase`
    /// that says why where windows cannot be shown.
    static RCShdPtr<UiMainWindow> create(char const* name, char const* title, NtForeignWidget widget,
                                         std::function<void(bool)> enableOwn);

    ~UiMainWindow() override;

    int getInputLevel() const override { return _inputLevel; }

    /// Keeps input from the window until the matching `admitInput`, but from the floating containers that come to the
    /// front meanwhile. Both nest; the last `admitInput` leaves all as it was.
    void refuseInput();
    void admitInput() noexcept;

    /// The innermost widget that has the keyboard whenever the window has it; borrowed, null if there is none.
    UiWidget* findWidgetWithKeyboard() const;

protected:
    UiMainWindow(char const* name, char const* title, NtForeignWidget widget, std::function<void(bool)> enableOwn);

    std::unique_ptr<NtWindow> createNative(NtPlatform& platform) override;
    void onResized(int width, int height) override;

private:
    void blockWidgetsIn(UiContainer const& container) const;

    NtForeignWidget _widget;
    std::function<void(bool)> _enableOwn;
    NtMainWindow* _native = nullptr;
    int _inputLevel = 0;
};

} // namespace Kv
