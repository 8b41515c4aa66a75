#include "brBrowserFloatingHandler.h"

#include "exBase.h"
#include "piBrowserSchemes.h"
#include "text/liString.h"

namespace Kv
{

namespace
{

// All in pixels.
constexpr GeVector2<int> windowSize{640, 444};
constexpr float buttonWidth = 84;
constexpr float buttonHeight = 28;
constexpr float gap = 7;

UiConstraint::Edge edge(float value, UiConstraint::Target target)
{
    return {value, UiConstraint::Pixels, target, {}};
}

void requireFileSystem(Vector<LiString> const& schemes)
{
    for (LiString const& scheme : schemes)
        if (scheme != PiBrowserSchemes::FsScheme)
            throw ExBase(__FILE__, __LINE__,
                         "There is no browser for the scheme " + LiStringUtil::getPrintable(scheme.toString()) +
                             ", only for " + LiStringUtil::getPrintable(PiBrowserSchemes::FsScheme.toString()));
}

} // namespace

BrBrowserFloatingHandler::BrBrowserFloatingHandler(RCShdPtr<UiContainer> const& parent, char const* title,
                                                   RCShdPtr<SnSelection> const& selection,
                                                   Vector<LiString> const& schemes, LiString const& place, Bookmarkable)
    : UiFloatingHandler(parent, "BrowserWindow", title, windowSize),
      _fileCb(this, &BrBrowserFloatingHandler::onFileActivated), _okCb(this, &BrBrowserFloatingHandler::onOk),
      _cancelCb(this, &BrBrowserFloatingHandler::onCancel),
      _browser(BrBrowser::create(getContainer(), "Browser", nullptr)),
      _ok(createButton("OK", 2 * gap + buttonWidth, _okCb))
{
    requireFileSystem(schemes);
    createButton("Cancel", gap, _cancelCb);
    _browser->setConstraint(
        UiConstraint({edge(0, UiConstraint::ParentLow), edge(buttonHeight + 2 * gap, UiConstraint::ParentLow),
                      edge(0, UiConstraint::ParentHigh), edge(-titleHeight, UiConstraint::ParentHigh)}));
    _browser->getPiWidget()->addCallback(PiWidget::Activate, &_fileCb);
    if (!place.isEmpty())
        _browser->setURL(place, HistoryEnum::None, UpdateEnum::AtOnce);
    _browser->select(selection);
}

BrBrowserFloatingHandler::~BrBrowserFloatingHandler() = default;

RCShdPtr<BrBrowser> const& BrBrowserFloatingHandler::getBrowser() const
{
    return _browser;
}

void BrBrowserFloatingHandler::setActivateCb(CbHandler<EvEvent>* handler)
{
    _activateCb = handler;
}

bool volatile* BrBrowserFloatingHandler::isClosed()
{
    return &_closed;
}

bool const volatile* BrBrowserFloatingHandler::isClosedConst() const
{
    return &_closed;
}

void BrBrowserFloatingHandler::show()
{
    _closed = false;
    UiFloatingHandler::show();
}

void BrBrowserFloatingHandler::hide()
{
    _closed = true;
    UiFloatingHandler::hide();
}

RCShdPtr<UiPushButton> BrBrowserFloatingHandler::createButton(char const* label, float right,
                                                              UiEventCallback<BrBrowserFloatingHandler>& cb)
{
    RCShdPtr<UiPushButton> button = UiPushButton::create(getContainer(), label, nullptr);
    button->getLabel().setString(label);
    button->setConstraint(
        UiConstraint({edge(buttonWidth, UiConstraint::OwnOpposite), edge(gap, UiConstraint::ParentLow),
                      edge(-right, UiConstraint::ParentHigh), edge(buttonHeight, UiConstraint::OwnOpposite)}));
    button->getPiWidget()->addCallback(PiWidget::Activate, &cb);
    return button;
}

void BrBrowserFloatingHandler::onFileActivated(EvEvent&)
{
    _ok->press();
}

void BrBrowserFloatingHandler::onOk(EvEvent&)
{
    _browser->takeTypedPath(
        [this]
        {
            EvEvent event(PiWidget::Activate);
            if (_activateCb)
                _activateCb->call(event);
        });
}

void BrBrowserFloatingHandler::onCancel(EvEvent&)
{
    hide();
}

} // namespace Kv
