#include "uiTopLevel.h"

#include "text/liString.h"
#include "uiEscapeButton.h"
#include "uiLatePeers.h"
#include "uiLayout.h"
#include "wsNative.h"

namespace Kv
{

namespace
{

/// Container of all widgets of a window.
class RootContainer : public UiContainer
{
public:
    RootContainer() : UiContainer("root") {}
};

} // namespace

UiTopLevel::UiTopLevel(char const* name, char const* title, RCShdPtr<WsWindowStyle> const& style)
    : UiWidget(name), _title(title), _style(style), _root(makeShd<RootContainer>()), _self(this, [](UiTopLevel*) {})
{
    LiStringUtil::requireUtf8(_title, "Window title");
    UiWidget::display(false);
    _root->_window = this;
}

UiTopLevel::~UiTopLevel()
{
    // Nobody finds the window any more, whatever its end brings about.
    _self.reset();
    dropNative();
    _root->_window = nullptr;
}

RCShdPtr<UiTopLevel> UiTopLevel::create(char const* name, char const* title, RCShdPtr<WsWindowStyle> const& style,
                                        UiResTable const*)
{
    return RCShdPtr<UiTopLevel>(new UiTopLevel(name, title, style));
}

UiWindow* UiTopLevel::getWindow() const
{
    return const_cast<UiTopLevel*>(this);
}

RCShdPtr<UiContainer> UiTopLevel::getRootContainer() const
{
    return _root;
}

RCShdPtr<WsWindow> UiTopLevel::getOSWindow() const
{
    return _osWindow;
}

bool UiTopLevel::redraw()
{
    UiLatePeers::getInstance().makeAll();
    if (isShown())
        _osWindow->getNative().redraw();
    return isShown();
}

void UiTopLevel::display(bool displayed)
{
    requireUiThread();
    if (displayed && !_osWindow)
        makeNative();
    UiWidget::display(displayed);
    if (displayed)
        _osWindow->getNative().show();
    else if (_osWindow)
        _osWindow->getNative().hide();
}

std::unique_ptr<NtPeer> UiTopLevel::createPeer(NtPlatform&, NtContainer&)
{
    return nullptr;
}

std::unique_ptr<NtWindow> UiTopLevel::createNative(NtPlatform& platform)
{
    std::shared_ptr<UiTopLevel> const owner = _owner.lock();
    NtWindow* const nativeOwner = owner && owner->_osWindow ? &owner->_osWindow->getNative() : nullptr;
    return platform.createWindow(getName(), _title, _root->getName(), _style->getFrame(), nativeOwner, *this);
}

void UiTopLevel::makeNative()
{
    NtPlatform& platform = WsNative::getPlatform();
    _osWindow = makeShd<WsWindow>(createNative(platform));
    try
    {
        _root->attachNative(platform, _osWindow->getNative().getContent());
    }
    catch (...)
    {
        dropNative();
        throw;
    }
}

void UiTopLevel::dropNative()
{
    _root->dropPeer();
    _osWindow.reset();
}

void UiTopLevel::onResized(int width, int height)
{
    RCShdPtr<UiTopLevel> const self(this);
    _root->takeRect({0, width, 0, height}, true);
    GeVector2<int> const overflow = UiLayout::measureOverflow(*_root);
    if (overflow.x > 0 || overflow.y > 0)
        _root->takeRect({0, width + overflow.x, 0, height + overflow.y}, true);
    _root->placePeers();
    _osWindow->getNative().setContentSize(_root->getRect().getWidth(), _root->getRect().getHeight());
}

void UiTopLevel::onEscape()
{
    RCShdPtr<UiTopLevel> const self(this);
    if (RCShdPtr<UiPushButton> const button = findEscapeButton(*_root))
        button->press();
}

void UiTopLevel::onCloseRequested()
{
    RCShdPtr<UiTopLevel> const self(this);
    if (RCShdPtr<UiPushButton> const button = findEscapeButton(*_root))
        button->press();
    else if (!needsAnswer(*_root))
        WsNative::getPlatform().endLoop();
}

} // namespace Kv
