#include <boost/python.hpp>

#include "pyDialog.h"

#include "evPointerEvent.h"
#include "pyUiError.h"
#include "pyWidgetValue.h"
#include "uiAppMgr.h"
#include "uiApplication.h"
#include "uiCursorGuard.h"
#include "uiLabel.h"
#include "uiLook.h"
#include "uiMoveContainer.h"
#include "uiPushButton.h"
#include "uiWidgetFactory.h"
#include "uiWidgetPredicate.h"
#include "wsCursorRegistry.h"
#include "wsScreen.h"
#include "xml/xmlDocument.h"

#include <algorithm>
#include <iterator>
#include <memory>

namespace bp = boost::python;

namespace Kv::PyextUi
{

namespace
{

// In pixels: the height of the title in a window of its own, and in a floating container.
constexpr int titleHeight = 24;
constexpr int floatingTitleHeight = 25;

/// Larger than any window, and small enough for sums of sizes.
constexpr int maxSize = 1 << 23;

int sizeOnScreen(int wanted, int screen)
{
    return wanted < 1 ? static_cast<int>(static_cast<float>(screen) * 0.8F) : wanted;
}

GeRectangle<int> makeFrame(int x, int y, int width, int height)
{
    return {x, x + width, y, y + height};
}

/// The loop takes the lock of the main interpreter, and would wait for it for ever inside another one.
void requireMainInterpreter()
{
    if (PyThreadState_Get()->interp != PyInterpreterState_Main())
        throw UiError(__FILE__, __LINE__, "Cannot run dialog: only the main interpreter of the process can.");
}

/// The face for events of a widget that raises any; null for every other.
RCShdPtr<PiWidget> findEventFace(RCShdPtr<UiWidget> const& widget)
{
    bool const raisesEvents = hasValue(findValueKind(*widget)) || dynamicCast<UiPushButton>(widget);
    return raisesEvents ? widget->getPiWidget() : nullptr;
}

} // namespace

std::string const Dialog::_closeButtonClickedKey = "CloseButtonClicked";

Dialog::Dialog(std::string const& title, std::string const& xmlString, int width, int height,
               Positionner const& position)
    : _xml(xmlString), _title(title), _width(width), _height(height), _topLevel(UiAppMgr::getInstance().getTopLevel()),
      _moveCb(this, &Dialog::onTitleBarMove), _armCb(this, &Dialog::onTitleBarPress),
      _disarmCb(this, &Dialog::onTitleBarRelease), _widgetCbs(makeShd<WidgetCbs>(this))
{
    createUi(position);
}

Dialog::~Dialog()
{
    _container->hide();
    _container->clearParent();
    WidgetCbs::releaseAll(_callbacks);
    WidgetCbs::releaseAll(_closeCallbacks);
    _widgetCbs.reset();
}

void Dialog::createUi(Positionner const& position)
{
    if (_width < 1 || _height < 1)
    {
        GeVector2<int> const screen = WsScreen::getInstance().getSize();
        _width = sizeOnScreen(_width, screen.x);
        _height = sizeOnScreen(_height, screen.y);
    }
    int const width = std::min(_width, maxSize);
    int const height = std::min(_height, maxSize);
    if (_topLevel.isNull())
    {
        GeVector2<int> const screen = WsScreen::getInstance().getSize();
        GeRectangle<int> const frame =
            makeFrame((screen.x - width) / 2, (screen.y - height) / 2, width, height + titleHeight);
        RCShdPtr<WsWindowStyle> const style = WsWindowStyleUtils::getNormalWindowStyle(
            frame, 0, BorderStyle(0), TitleBarStyle(0), TaskBarStyle(0), StackingStyle(0), CloseButtonStyle(1));
        _topLevel = UiTopLevel::create(_title.c_str(), _title.c_str(), style, nullptr);
        _ownTopLevel = true;
        _container = createTopLevelPanel(_topLevel);
    }
    else
        _container = createFloatingContainer(width, height, position.divisions, position.position, _title);
    XmlDocument const document(_xml);
    RCShdPtr<XmlElement> const root = document.getRoot();
    UiWidgetFactory::createWidget(_container, *root);
}

RCShdPtr<UiContainer> Dialog::createTopLevelPanel(RCShdPtr<UiTopLevel> const& topLevel)
{
    RCShdPtr<UiContainer> const root = topLevel->getRootContainer();
    constexpr auto fill = UiConstraint::Type(3);
    constexpr auto low = UiConstraint::Target(0);
    constexpr auto high = UiConstraint::Target(1);
    UiConstraint const constraint(0.0F, 0.0F, 0.0F, 0.0F, fill, fill, fill, fill, low, low, high, high, "", "", "", "");
    RCShdPtr<UiContainer> panel = UiContainer::create(root, "panel", nullptr);
    panel->setConstraint(constraint);
    return panel;
}

RCShdPtr<UiContainer> Dialog::createFloatingContainer(int width, int height, int divisions, int position,
                                                      std::string const& title)
{
    RCShdPtr<UiPanel> const panel = UiAppMgr::getInstance().getMainPanel();
    GeRectangle<int> const size = panel->getRect();
    RCShdPtr<UiContainer> container = UiMoveContainer::create(panel, "Whatever", nullptr);
    GeRectangle<int> const place = panel->getRect();
    int const x = size.getWidth() / 2 - width / 2 + place.xMin;
    int const y = size.getHeight() / divisions * position - height / 2 + place.yMin;
    container->setRect(makeFrame(x, y, width, height + floatingTitleHeight), true);
    createTitleBar(container, title);
    container->setKeyboardFocusable(true);
    if (RCShdPtr<UiContainer> const root = container->getWindow()->getRootContainer())
    {
        container->show();
        root->setFocusWidget(container);
        root->front(container);
    }
    return container;
}

void Dialog::createTitleBar(RCShdPtr<UiContainer> const& container, std::string const& title)
{
    RCShdPtr<UiLabel> const titleBar = UiLabel::create(container, "titleBar", nullptr);
    titleBar->getLabel().setString(title.c_str());
    constexpr auto pixels = UiConstraint::Type(0);
    constexpr auto low = UiConstraint::Target(0);
    constexpr auto high = UiConstraint::Target(1);
    UiConstraint const constraint(0.0F, -24.0F, 0.0F, 0.0F, pixels, pixels, pixels, pixels, low, high, high, high, "",
                                  "", "", "");
    RCShdPtr<UiFrame> const frame = makeShd<UiFrameLineBottom>();
    titleBar->setConstraint(constraint);
    titleBar->setFrame(frame, UiWidget::DefaultFrame);
    titleBar->setColor(UiWidget::BackgroundColor, UiColorRegistry::getInstance().getColor(UiColorRegistry::Grey65));
    titleBar->setPointerMoveCb(&_moveCb);
    titleBar->setPointerDownCb(&_armCb);
    titleBar->setPointerUpCb(&_disarmCb);
}

void Dialog::onTitleBarMove(EvEvent& event)
{
    _container->mmove(dynamic_cast<EvPointerMoveEvent&>(event));
}

void Dialog::onTitleBarPress(EvEvent& event)
{
    _container->arm(dynamic_cast<EvPointerButtonDownEvent&>(event));
}

void Dialog::onTitleBarRelease(EvEvent& event)
{
    _container->disarm(dynamic_cast<EvPointerButtonUpEvent&>(event));
}

std::string Dialog::launch()
{
    requireMainInterpreter();
    clearCloseCallbacks();
    setupCloseCallbacks();
    std::unique_ptr<UiAppDisabler> disabler;
    if (_ownTopLevel)
    {
        UiAppMgr::getInstance().setTopLevel(_topLevel);
        _topLevel->show();
    }
    else
        disabler = std::make_unique<UiAppDisabler>();
    _container->getParent()->front(_container);
    _container->show();
    {
        UiCursorGuard const cursor(WsCursorRegistry::Normal);
        _closed = false;
        UiApplication::getInstance()->localMessageLoop(&_closed, &_closed);
    }
    _container->hide();
    if (_ownTopLevel)
    {
        if (RCShdPtr<WsWindow> const window = _topLevel->getOSWindow())
            window->flushAllEvents();
        _topLevel->hide();
        UiAppMgr::getInstance().releaseTopLevel();
    }
    return getCloseButtonClicked();
}

void Dialog::redraw()
{
    _topLevel->redraw();
}

void Dialog::hide() const
{
    _container->hide();
}

std::string Dialog::getCloseButtonClicked() const
{
    return _closeButtonClicked;
}

std::string const& Dialog::getCloseButtonClickedKey()
{
    return _closeButtonClickedKey;
}

void Dialog::disableNextClose()
{
    _disableNextClose = true;
}

PyCallables& Dialog::getCallables()
{
    return _callables;
}

void Dialog::clearCloseCallbacks()
{
    for (RCStrongPtr<CallbackSet> const& set : _closeCallbacks)
    {
        RCShdPtr<UiPushButton> const button = dynamicCast<UiPushButton>(getWidget(set->widgetName));
        if (!button || !button->getPiWidget()->removeCallback(set->eventType, set->handler.get()))
            unwireNamesake(*set);
    }
    WidgetCbs::releaseAll(_closeCallbacks);
}

void Dialog::unwireNamesake(CallbackSet const& set) const
{
    PrdPredicate<UiWidget> const isNamesake([&set](UiWidget const& widget)
                                            { return widget.getName() == set.widgetName; });
    Iterator<RCShdPtr<UiWidget>> widgets = _container->findWidgets(isNamesake);
    for (widgets.first(); !widgets.atEnd(); widgets.next())
        if (widgets.item()->getPiWidget()->removeCallback(set.eventType, set.handler.get()))
            return;
}

void Dialog::setupCloseCallbacks()
{
    PrdPredicate<UiWidget> const isCloseButton =
        UiWidgetPredicate::isType(RttiGenType1<UiPushButton, UiWidget>::getInstance()) &&
        UiWidgetPredicate::nameStartsWith(closeButtonPrefix);
    Iterator<RCShdPtr<UiWidget>> widgets = _container->findWidgets(isCloseButton);
    if (widgets.getCardinality() == 0)
        throw UiError(__FILE__, __LINE__, "Cannot close dialog: there must be at least one close button");
    for (widgets.first(); !widgets.atEnd(); widgets.next())
    {
        RCShdPtr<UiPushButton> const button = dynamicCast<UiPushButton>(widgets.item());
        if (!button)
            continue;
        auto const set = makeStrong<CallbackSet>(CallbackSet{button->getName(), PiWidget::Activate, nullptr, {}});
        _closeCallbacks.push_back(set);
        _widgetCbs->addCloseHandler(button->getPiWidget(), set);
    }
}

RCShdPtr<UiWidget> Dialog::getWidget(std::string const& name) const
{
    RCShdPtr<UiWidget> widget = _container->findWidget(LiString(name));
    if (!widget)
        throw UiError(__FILE__, __LINE__, "Cannot find widget: the specified widget does not exist.");
    return widget;
}

bp::object Dialog::getValue(std::string const& widgetName) const
{
    return getWidgetValue(_container, widgetName);
}

bp::dict Dialog::getValues() const
{
    bp::dict values;
    getWidgetValues(_container, values);
    return values;
}

void Dialog::setValue(std::string const& widgetName, bp::object const& value, bool invokeCallback)
{
    setWidgetValue(_container, widgetName, value, invokeCallback);
}

void Dialog::setValue(std::string const& widgetName, bp::object const& value)
{
    setValue(widgetName, value, true);
}

void Dialog::setValues(bp::dict const& values, bool invokeCallback)
{
    setWidgetValues(_container, values, invokeCallback);
}

void Dialog::setValues(bp::dict const& values)
{
    setValues(values, true);
}

bp::object Dialog::getWidgetValue(RCShdPtr<UiContainer> container, std::string const& widgetName) const
{
    for (RCShdPtr<UiWidget> const& child : container->getChildren())
    {
        ValueKind const kind = findValueKind(*child);
        if (kind == ValueKind::Container)
        {
            bp::object value = getWidgetValue(dynamicCast<UiContainer>(child), widgetName);
            if (!value.is_none())
                return value;
        }
        else if (hasValue(kind) && child->getName() == widgetName)
            return readValue(*child, kind);
    }
    return bp::object();
}

void Dialog::getWidgetValues(RCShdPtr<UiContainer> container, bp::dict& values) const
{
    if (std::string const closeButton = getCloseButtonClicked(); !closeButton.empty())
        values[getCloseButtonClickedKey()] = closeButton;
    for (RCShdPtr<UiWidget> const& child : container->getChildren())
    {
        ValueKind const kind = findValueKind(*child);
        if (kind == ValueKind::Container)
            getWidgetValues(dynamicCast<UiContainer>(child), values);
        else if (hasValue(kind))
            values[child->getName()] = readValue(*child, kind);
    }
}

bool Dialog::setWidgetValue(RCShdPtr<UiContainer> container, std::string const& widgetName, bp::object const& value,
                            bool invokeCallback)
{
    for (RCShdPtr<UiWidget> const& child : container->getChildren())
    {
        ValueKind const kind = findValueKind(*child);
        if (kind == ValueKind::Container)
        {
            if (setWidgetValue(dynamicCast<UiContainer>(child), widgetName, value, invokeCallback))
                return true;
        }
        else if (hasValue(kind) && child->getName() == widgetName)
        {
            writeValue(*child, kind, value, MenuEntries::Replace, invokeCallback);
            return true;
        }
    }
    return false;
}

void Dialog::setWidgetValues(RCShdPtr<UiContainer> container, bp::dict const& values, bool invokeCallback)
{
    for (RCShdPtr<UiWidget> const& child : container->getChildren())
    {
        ValueKind const kind = findValueKind(*child);
        if (kind == ValueKind::Container)
            setWidgetValues(dynamicCast<UiContainer>(child), values, invokeCallback);
        else if (values.has_key(child->getName()) && hasValue(kind))
            writeValue(*child, kind, values.get(child->getName()), MenuEntries::Add, invokeCallback);
    }
}

void Dialog::addCallback(std::string const& widgetName, PiWidget::EventType eventType, PyObject* cb)
{
    RCShdPtr<UiWidget> const widget = getWidget(widgetName);
    RCShdPtr<PiWidget> const piWidget = findEventFace(widget);
    auto const set = makeStrong<CallbackSet>(CallbackSet{widgetName, eventType, cb, {}});
    _callbacks.push_back(set);
    auto known = _callbacksByKey.end();
    try
    {
        known = _callbacksByKey.emplace(CallbackKey(widgetName, eventType, cb), set.get());
        if (piWidget)
            _widgetCbs->addPythonHandler(piWidget, set);
        // Last, since it alone cannot be taken back without fail.
        _callables.add(*set);
    }
    catch (...)
    {
        takeBack(std::prev(_callbacks.end()), known, piWidget);
        throw;
    }
}

void Dialog::removeCallback(std::string const& widgetName, PiWidget::EventType eventType, PyObject* cb)
{
    RCShdPtr<UiWidget> const widget = getWidget(widgetName);
    CallbackKey const key(widgetName, eventType, cb);
    auto const found = _callbacksByKey.lower_bound(key);
    if (found == _callbacksByKey.end() || found->first != key)
        return;
    RCShdPtr<PiWidget> const piWidget = findEventFace(widget);
    auto const place = findCallback(found->second);
    // First, since it alone can fail.
    _callables.remove(**place);
    takeBack(place, found, piWidget);
}

void Dialog::takeBack(CallbackSets::iterator place, CallbacksByKey::iterator known, RCShdPtr<PiWidget> const& piWidget)
{
    RCStrongPtr<CallbackSet> const set = *place;
    if (piWidget)
        piWidget->removeCallback(set->eventType, set->handler.get());
    if (known != _callbacksByKey.end())
        _callbacksByKey.erase(known);
    _callbacks.erase(place);
    WidgetCbs::release(set);
}

Dialog::CallbackSets::iterator Dialog::findCallback(CallbackSet const* set)
{
    auto first = _callbacks.begin();
    auto last = std::prev(_callbacks.end());
    for (; first->get() != set && last->get() != set; ++first, --last)
        ;
    return first->get() == set ? first : last;
}

// It changes how the dialog looks. NOLINTNEXTLINE(readability-make-member-function-const)
void Dialog::setWidgetResourceName(std::string const& widgetName, std::string const& resName)
{
    UiWidget::setWidgetResTable(getWidget(widgetName), resName);
}

void Dialog::displayWidget(std::string const& widgetName, bool display) const
{
    getWidget(widgetName)->display(display);
}

void Dialog::showWidget(std::string const& widgetName) const
{
    getWidget(widgetName)->display(true);
}

void Dialog::hideWidget(std::string const& widgetName) const
{
    getWidget(widgetName)->display(false);
}

bool Dialog::isDisplayed(std::string const& widgetName) const
{
    return getWidget(widgetName)->isDisplayed();
}

void Dialog::enableWidget(std::string const& widgetName, bool enable) const
{
    getWidget(widgetName)->setEnabled(enable);
}

bool Dialog::isEnabled(std::string const& widgetName) const
{
    return getWidget(widgetName)->isEnabled();
}

} // namespace Kv::PyextUi

namespace Kv
{

template class RCBasePtr<PyextUi::Dialog>;
template class Iterator<RCShdPtr<UiWidget>>;

} // namespace Kv
