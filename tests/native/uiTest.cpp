#include "exBase.h"
#include "piWidget.h"
#include "uiContainer.h"
#include "uiCursorGuard.h"
#include "uiDualState.h"
#include "uiLabel.h"
#include "uiLook.h"
#include "uiMenu.h"
#include "uiMoveContainer.h"
#include "uiTextField.h"
#include "uiTopLevel.h"
#include "wsCursorRegistry.h"

#include <QApplication>
#include <QLabel>
#include <QPointer>

#include <functional>
#include <gtest/gtest.h>
#include <string>
#include <utility>
#include <vector>

using namespace Kv;

namespace
{

class Handler : public CbHandler<EvEvent>
{
public:
    explicit Handler(std::function<void(EvEvent&)> action) : _action(std::move(action)) {}
    void call(EvEvent& event) override { _action(event); }

private:
    std::function<void(EvEvent&)> _action;
};

class Dispatch : public testing::Test
{
protected:
    std::function<void(EvEvent&)> note(std::string const& word)
    {
        return [this, word](EvEvent&) { heard += word; };
    }

    RCShdPtr<PiWidget> widget = makeShd<PiWidget>();
    std::string heard;
};

RCShdPtr<UiTopLevel> makeWindow()
{
    RCShdPtr<WsWindowStyle> const style = WsWindowStyleUtils::getNormalWindowStyle(
        {0, 200, 0, 100}, 0, BorderStyle(0), TitleBarStyle(0), TaskBarStyle(0), StackingStyle(0), CloseButtonStyle(1));
    return UiTopLevel::create("window", "Window", style, nullptr);
}

UiConstraint::Edge edge(float value, UiConstraint::Target target, char const* sibling = "",
                        UiConstraint::Type type = UiConstraint::Pixels)
{
    return {value, type, target, LiString(sibling)};
}

/// Ten pixels high, its top edge as given, and as wide as what holds it.
UiConstraint row(UiConstraint::Edge const& top)
{
    return UiConstraint({edge(0, UiConstraint::ParentLow), edge(10, UiConstraint::OwnOpposite),
                         edge(0, UiConstraint::ParentHigh), top});
}

std::string nameOf(int number)
{
    return "row" + std::to_string(number);
}

} // namespace

TEST_F(Dispatch, IsNotDisturbedByHandlersThatComeAndGo)
{
    Handler last(note("l"));
    Handler removed(note("r"));
    Handler added(note("n"));
    Handler* self = nullptr;
    Handler change(
        [&](EvEvent& event)
        {
            heard += "c";
            widget->removeCallback(event.getType(), &removed);
            widget->removeCallback(event.getType(), self);
            widget->addCallback(event.getType(), &added);
            // A nested event sees the change, and leaves the places of this one alone.
            widget->fire(event.getType());
            heard += "|";
        });
    self = &change;
    for (Handler* const handler : {&change, &removed, &last})
        widget->addCallback(PiWidget::State, handler);
    widget->fire(PiWidget::State);
    EXPECT_EQ(heard, "cln|l");
    widget->fire(PiWidget::State);
    EXPECT_EQ(heard, "cln|lln");
}

TEST_F(Dispatch, OutlivesTheLastReferenceToTheWidget)
{
    Handler drop([this](EvEvent&) { widget.reset(); });
    Handler last(note("l"));
    widget->addCallback(PiWidget::State, &drop);
    widget->addCallback(PiWidget::State, &last);
    widget->fire(PiWidget::State);
    EXPECT_EQ(heard, "l");
}

TEST(UiLayout, PlacesEdgesByEveryTarget)
{
    RCShdPtr<UiContainer> const root = makeWindow()->getRootContainer();
    RCShdPtr<UiContainer> const inner = UiContainer::create(root, "inner", nullptr);
    // Inside out and in whole units: the sibling that it hangs on comes later.
    inner->setConstraint(UiConstraint({edge(-3, UiConstraint::OwnOpposite, "", UiConstraint::Units),
                                       edge(2, UiConstraint::SiblingEdge, "later"), edge(-20, UiConstraint::ParentHigh),
                                       edge(-5, UiConstraint::ParentHigh)}));
    RCShdPtr<UiLabel> const later = UiLabel::create(root, "later", nullptr);
    later->setConstraint(UiConstraint({edge(4, UiConstraint::SiblingEdge, "inner"), edge(1, UiConstraint::ParentLow),
                                       edge(30, UiConstraint::OwnOpposite),
                                       edge(2, UiConstraint::OwnOpposite, "", UiConstraint::Units)}));
    RCShdPtr<UiLabel> const nested = UiLabel::create(inner, "nested", nullptr);
    nested->setConstraint(row(edge(0, UiConstraint::ParentHigh)));
    root->setRect({0, 200, 0, 100}, true);
    EXPECT_EQ(inner->getRect(), (GeRectangle<int>{201, 180, 17, 95}));
    EXPECT_EQ(later->getRect(), (GeRectangle<int>{184, 214, 1, 15}));
    EXPECT_EQ(nested->getRect(), (GeRectangle<int>{201, 180, 85, 95}));
}

class LongChain : public testing::TestWithParam<int>
{
};

INSTANTIATE_TEST_SUITE_P(InEveryOrder, LongChain, testing::Values(1, -1, 7919));

TEST_P(LongChain, IsLaidOutWhateverTheOrderOfTheSiblings)
{
    constexpr int count = 100000;
    RCShdPtr<UiContainer> const root = makeWindow()->getRootContainer();
    std::vector<RCShdPtr<UiLabel>> rows(count);
    for (long long place = 0; place < count; ++place)
    {
        int const number = static_cast<int>(((place * GetParam()) % count + count) % count);
        RCShdPtr<UiLabel> const label = UiLabel::create(root, nameOf(number).c_str(), nullptr);
        std::string const above = nameOf(number - 1);
        label->setConstraint(
            row(number == 0 ? edge(0, UiConstraint::ParentHigh) : edge(-5, UiConstraint::SiblingEdge, above.c_str())));
        rows.at(static_cast<std::size_t>(number)) = label;
    }
    root->setRect({0, 50, 0, 1000}, true);
    for (int number = 0; number < count; number += 11111)
        EXPECT_EQ(rows.at(static_cast<std::size_t>(number))->getRect(),
                  (GeRectangle<int>{0, 50, 990 - 15 * number, 1000 - 15 * number}));
    EXPECT_EQ(root->findWidget(LiString(nameOf(count - 1))).get(), rows.back().get());
    EXPECT_EQ(root->findWidgets(PrdPredicate<UiWidget>([](UiWidget const&) { return true; })).getCardinality(), count);
}

TEST(UiContainer, FindsByNameWhatIsInTheTreeNow)
{
    RCShdPtr<UiContainer> const root = makeWindow()->getRootContainer();
    RCShdPtr<UiContainer> const inner = UiContainer::create(root, "inner", nullptr);
    EXPECT_TRUE(root->findWidget(LiString("name")).isNull());
    RCShdPtr<UiWidget> const behind = UiLabel::create(root, "name", nullptr);
    EXPECT_EQ(root->findWidget(LiString("name")), behind);
    RCShdPtr<UiWidget> const ahead = UiLabel::create(inner, "name", nullptr);
    EXPECT_EQ(root->findWidget(LiString("name")), ahead);
    ahead->clearParent();
    EXPECT_TRUE(ahead->getParent().isNull());
    EXPECT_EQ(root->findWidget(LiString("name")), behind);
    inner->addChild(ahead);
    inner->clearParent();
    EXPECT_EQ(root->findWidget(LiString("name")), behind);
    EXPECT_TRUE(root->findWidget(LiString("inner")).isNull());
    EXPECT_EQ(inner->findWidget(LiString("name")), ahead);
    EXPECT_TRUE(root->findWidget(LiString("root")).isNull());
}

TEST(UiContainer, IsTakenDownFromTheScreenWithoutAnEvent)
{
    std::vector<PiWidget::EventType> heard;
    Handler handler([&heard](EvEvent& event) { heard.push_back(event.getType()); });
    RCShdPtr<UiTopLevel> window = makeWindow();
    RCShdPtr<UiContainer> panel = UiContainer::create(window->getRootContainer(), "panel", nullptr);
    RCShdPtr<UiTextField> const field = UiTextField::create(panel, "field", nullptr);
    RCShdPtr<UiMenu> const menu = UiMenu::create(panel, "menu", nullptr);
    RCShdPtr<UiDualState> const toggle = UiDualState::create(panel, "toggle", nullptr);
    menu->append("entry");
    for (RCShdPtr<UiWidget> const& widget :
         {RCShdPtr<UiWidget>(field), RCShdPtr<UiWidget>(menu), RCShdPtr<UiWidget>(toggle)})
        for (PiWidget::EventType const type :
             {PiWidget::Enable, PiWidget::Disable, PiWidget::State, PiWidget::Activate, PiWidget::ValueChanged})
            widget->getPiWidget()->addCallback(type, &handler);
    window->show();
    EXPECT_TRUE(window->isShown());
    menu->setSelection(0, false);
    field->setString("text", UiTextField::End, false, false);
    toggle->setState(true, false);
    panel->hide();
    panel->show();
    panel->clearParent();
    panel.reset();
    EXPECT_TRUE(field->getParent().isNull());
    EXPECT_STREQ(field->getString(), "text");
    EXPECT_STREQ(menu->getStrPtr(), "entry");
    window->hide();
    window.reset();
    EXPECT_TRUE(heard.empty());
    // Whoever owned the handlers may be gone with the parent.
    toggle->setState(false, true);
    EXPECT_TRUE(heard.empty());
}

TEST(UiContainer, KeepsWhatStandsInItWhenItGetsAColour)
{
    RCShdPtr<UiTopLevel> const window = makeWindow();
    RCShdPtr<UiContainer> const panel = UiContainer::create(window->getRootContainer(), "panel", nullptr);
    RCShdPtr<UiLabel> const label = UiLabel::create(panel, "label", nullptr);
    window->show();
    QPointer<QLabel> const native = QApplication::activeModalWidget()->findChild<QLabel*>("label");
    panel->setColor(UiWidget::BackgroundColor, UiColorRegistry::getInstance().getColor(UiColorRegistry::Grey65));
    EXPECT_TRUE(native && native->isVisible());
    panel->setFrame(makeShd<UiFrameLineBottom>(), UiWidget::DefaultFrame);
    panel->setFrame(nullptr, UiWidget::DefaultFrame);
    EXPECT_TRUE(native && native->isVisible());
    window->hide();
}

TEST(UiMoveContainer, StandsWhereItIsToldToAlsoWhereItsParentIsSmaller)
{
    RCShdPtr<UiTopLevel> const window = makeWindow();
    RCShdPtr<UiContainer> const root = window->getRootContainer();
    RCShdPtr<UiMoveContainer> const floating = UiMoveContainer::create(root, "floating", nullptr);
    RCShdPtr<UiLabel> const label = UiLabel::create(floating, "label", nullptr);
    label->setConstraint(row(edge(0, UiConstraint::ParentHigh)));
    window->show();
    GeRectangle<int> const large{-50, 250, -60, 90};
    floating->setRect(large, true);
    EXPECT_EQ(floating->getRect(), large);
    EXPECT_EQ(label->getRect().getWidth(), large.getWidth());
    floating->arm(EvPointerButtonDownEvent({20, 20}));
    floating->mmove(EvPointerMoveEvent({30, 20}, true));
    EXPECT_EQ(floating->getRect(), large);
    window->hide();
}

TEST(UiMoveContainer, GetsWhatStandsInItAsSoonAsSomebodyAsksForTheKeyboard)
{
    RCShdPtr<UiTopLevel> const window = makeWindow();
    window->show();
    RCShdPtr<UiContainer> const root = window->getRootContainer();
    RCShdPtr<UiMoveContainer> const floating = UiMoveContainer::create(root, "floating", nullptr);
    floating->setRect({10, 190, 10, 90}, true);
    RCShdPtr<UiTextField> const field = UiTextField::create(floating, "field", nullptr);
    field->setKeyboardFocusable(true);
    root->setFocusWidget(field);
    EXPECT_TRUE(field->hasKeyboard() && field->holdsValue());
    // One that nobody else has goes with the turn.
    UiMoveContainer::create(root, "lost", nullptr);
    EXPECT_EQ(root->getChildren().size(), 2);
    QCoreApplication::processEvents();
    EXPECT_EQ(root->getChildren().size(), 1);
    window->hide();
}

TEST(UiCursorGuard, GivesTheCursorBackAlsoOnTheWayOutOfAnException)
{
    WsCursorRegistry const& registry = WsCursorRegistry::getInstance();
    UiCursorGuard const busy(WsCursorRegistry::Busy);
    auto const fail = []
    {
        UiCursorGuard const normal(WsCursorRegistry::Normal);
        UiCursorGuard const unknown(LiString("unknown"));
    };
    EXPECT_THROW(fail(), ExBase);
    EXPECT_EQ(registry.getCurrent(), WsCursorRegistry::Busy);
}
