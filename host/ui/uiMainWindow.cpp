#include "uiMainWindow.h"

#include "ntPlatform.h"
#include "uiLatePeers.h"
#include "uiMoveContainer.h"
#include "uiPanel.h"

#include <utility>

namespace Kv
{

namespace
{

UiWidget* findWidgetWithKeyboardIn(UiContainer const& container)
{
    for (RCShdPtr<UiWidget> const& child : container.getChildren())
    {
        if (!child->hasKeyboard())
            continue;
        auto const* const inner = dynamic_cast<UiContainer const*>(child.get());
        UiWidget* const innermost = inner ? findWidgetWithKeyboardIn(*inner) : nullptr;
        return innermost ? innermost : child.get();
    }
    return nullptr;
}

} // namespace

UiMainWindow::UiMainWindow(char const* name, char const* title, NtForeignWidget widget,
                           std::function<void(bool)> enableOwn)
    : UiTopLevel(name, title, nullptr), _widget(widget), _enableOwn(std::move(enableOwn))
{
}

UiMainWindow::~UiMainWindow() = default;

RCShdPtr<UiMainWindow> UiMainWindow::create(char const* name, char const* title, NtForeignWidget widget,
                                            std::function<void(bool)> enableOwn)
{
    RCShdPtr<UiMainWindow> window(new UiMainWindow(name, title, widget, std::move(enableOwn)));
    window->makeNative();
    return window;
}

void UiMainWindow::refuseInput()
{
    requireUiThread();
    UiLatePeers::getInstance().makeAll();
    _native->refuseInput();
    ++_inputLevel;
    try
    {
        blockWidgetsIn(*getRootContainer());
    }
    catch (...)
    {
        admitInput();
        throw;
    }
}

void UiMainWindow::admitInput() noexcept
{
    --_inputLevel;
    // What fails is left to the next one to whom input is refused or admitted: nobody can be told at the end of a run.
    try
    {
        blockWidgetsIn(*getRootContainer());
    }
    catch (...) // NOLINT(bugprone-empty-catch)
    {
    }
    _native->admitInput();
}

UiWidget* UiMainWindow::findWidgetWithKeyboard() const
{
    return findWidgetWithKeyboardIn(*getRootContainer());
}

std::unique_ptr<NtWindow> UiMainWindow::createNative(NtPlatform& platform)
{
    std::unique_ptr<NtMainWindow> native = platform.adoptWindow(_widget, _enableOwn, *this);
    _native = native.get();
    return native;
}

void UiMainWindow::onResized(int width, int height)
{
    RCShdPtr<UiContainer> const root = getRootContainer();
    GeRectangle<int> const before = root->getRect();
    // The panels hear of their own places.
    root->setRect({0, width, 0, height}, false);
    UiMoveContainer::follow(*root, before);
}

void UiMainWindow::blockWidgetsIn(UiContainer const& container) const
{
    for (RCShdPtr<UiWidget> const& child : container.getChildren())
    {
        if (auto const* const panel = dynamic_cast<UiPanel const*>(child.get()))
            blockWidgetsIn(*panel);
        else if (auto* const floating = dynamic_cast<UiMoveContainer*>(child.get()))
            floating->followInputLevel(_inputLevel);
        else
            child->setBlocked(_inputLevel > 0);
    }
}

} // namespace Kv
