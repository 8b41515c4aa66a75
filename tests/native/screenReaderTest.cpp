#include "piWidget.h"
#include "uiDualState.h"
#include "uiLabel.h"
#include "uiMainWindow.h"
#include "uiMenu.h"
#include "uiMoveContainer.h"
#include "uiPushButton.h"
#include "uiTextField.h"
#include "uiTopLevel.h"
#include "wsWindow.h"

#include <QAccessible>
#include <QApplication>
#include <QTest>

#include <gtest/gtest.h>
#include <string>
#include <vector>

using namespace Kv;

namespace
{

/// A place in a window, in rows from its bottom and in columns.
UiConstraint at(int row, int column, int columns = 1)
{
    using Edge = UiConstraint::Edge;
    auto const edge = [](int value, UiConstraint::Target target) {
        return Edge{static_cast<float>(value), UiConstraint::Pixels, target, {}};
    };
    return UiConstraint({edge(100 * column, UiConstraint::ParentLow), edge(28 * row, UiConstraint::ParentLow),
                         edge(100 * columns, UiConstraint::OwnOpposite), edge(28, UiConstraint::OwnOpposite)});
}

/// What a screen reader is told of the widgets of a window.
class ScreenReader : public testing::Test
{
protected:
    void TearDown() override { QAccessible::setActive(false); }

    /// Shows the window, which is read from then on.
    void show()
    {
        window->show();
        QCoreApplication::processEvents();
        QAccessible::setActive(true);
        QCoreApplication::processEvents();
    }

    template <typename Kind> RCShdPtr<Kind> add(char const* name, UiConstraint const& place)
    {
        RCShdPtr<Kind> widget = Kind::create(parent, name, nullptr);
        widget->setConstraint(place);
        return widget;
    }

    RCShdPtr<UiLabel> addLabel(char const* name, char const* text, UiConstraint const& place)
    {
        RCShdPtr<UiLabel> label = add<UiLabel>(name, place);
        label->getLabel().setString(text);
        return label;
    }

    static QAccessibleInterface* find(char const* name)
    {
        QCoreApplication::processEvents();
        for (QWidget* const widget : QApplication::allWidgets())
            if (widget->objectName() == QLatin1String(name))
                return QAccessible::queryAccessibleInterface(widget);
        return nullptr;
    }

    static std::string nameOf(char const* name) { return find(name)->text(QAccessible::Name).toStdString(); }

    /// The objects that a widget says it is labelled by.
    static std::vector<std::string> labelsOf(char const* name)
    {
        std::vector<std::string> labels;
        for (auto const& [label, relation] : find(name)->relations(QAccessible::Label))
            labels.push_back(label->object()->objectName().toStdString());
        return labels;
    }

    RCShdPtr<UiTopLevel> window = UiTopLevel::create(
        "window", "A title",
        WsWindowStyleUtils::getNormalWindowStyle({0, 600, 0, 300}, 0, BorderStyle(0), TitleBarStyle(0), TaskBarStyle(0),
                                                 StackingStyle(0), CloseButtonStyle(1)),
        nullptr);
    RCShdPtr<UiContainer> parent = window->getRootContainer();
};

} // namespace

TEST_F(ScreenReader, CallsWidgetsByTheLabelOfTheirRow)
{
    addLabel("caption1", "Save & close", at(5, 0));
    add<UiTextField>("field", at(5, 1));
    add<UiDualState>("toggle", at(4, 1));
    addLabel("caption2", "Do you win ?", at(4, 0));
    addLabel("caption3", "Size", at(3, 0));
    add<UiMenu>("width", at(3, 1));
    add<UiMenu>("height", at(3, 2));
    addLabel("caption4", "Depth", at(3, 3));
    add<UiTextField>("depth", at(3, 4));
    add<UiDualState>("fast", at(2, 0));
    addLabel("caption5", "Fast", at(2, 1));
    add<UiDualState>("exact", at(2, 2));
    addLabel("caption6", "Exact", at(2, 3));
    add<UiTextField>("nameless", at(1, 0));
    add<UiPushButton>("CloseButton_OK", at(0, 0))->getLabel().setString("OK & go");
    show();
    EXPECT_EQ(nameOf("field"), "Save & close");
    EXPECT_EQ(nameOf("caption1"), "Save & close");
    EXPECT_EQ(labelsOf("field"), std::vector<std::string>{"caption1"});
    EXPECT_EQ(nameOf("toggle"), "Do you win ?");
    EXPECT_EQ(labelsOf("toggle"), std::vector<std::string>{"caption2"});
    EXPECT_EQ(nameOf("width") + nameOf("height") + nameOf("depth"), "SizeSizeDepth");
    EXPECT_EQ(nameOf("fast") + nameOf("exact"), "FastExact");
    EXPECT_EQ(labelsOf("exact"), std::vector<std::string>{"caption6"});
    EXPECT_EQ(nameOf("nameless"), "");
    EXPECT_EQ(nameOf("CloseButton_OK"), "OK & go");
    EXPECT_EQ(nameOf("window"), "A title");
    // A caption is no mark of a shortcut.
    QTest::keyClick(QApplication::activeModalWidget(), Qt::Key_Space, Qt::AltModifier);
    EXPECT_EQ(QApplication::focusWidget()->objectName().toStdString(), "field");
}

TEST_F(ScreenReader, GoesByWhereWidgetsStandAndNotByTheirContainers)
{
    RCShdPtr<UiContainer> const root = parent;
    parent = add<UiContainer>("left", at(0, 0));
    addLabel("caption", "Note", at(0, 0));
    parent = root;
    parent = add<UiContainer>("right", at(0, 1));
    add<UiTextField>("field", at(0, 0));
    show();
    EXPECT_EQ(nameOf("field"), "Note");
    EXPECT_EQ(nameOf("left") + nameOf("right"), "");
}

TEST_F(ScreenReader, HearsOfWhatChanges)
{
    RCShdPtr<UiLabel> const old = addLabel("old", "Old & plain", at(0, 0));
    RCShdPtr<UiLabel> const other = addLabel("other", "Other", at(0, 0));
    RCShdPtr<UiTextField> const field = add<UiTextField>("field", at(0, 1));
    field->setTooltip("Not <b>bold</b>");
    other->display(false);
    show();
    EXPECT_EQ(nameOf("field"), "Old & plain");
    EXPECT_EQ(find("field")->text(QAccessible::Description).toStdString(), "Not <b>bold</b>");
    old->getLabel().setString("New");
    EXPECT_EQ(nameOf("field"), "New");
    other->display(true);
    old->display(false);
    EXPECT_EQ(nameOf("field"), "Other");
    other->display(false);
    EXPECT_NE(nameOf("field"), "");
}

TEST_F(ScreenReader, CallsAFloatByItsTitle)
{
    QWidget own;
    own.resize(400, 300);
    RCShdPtr<UiMainWindow> const main = UiMainWindow::create("main", "Main", {&own}, [](bool) {});
    RCShdPtr<UiMoveContainer> const floating = UiMoveContainer::create(main->getRootContainer(), "float", nullptr);
    floating->setRect({10, 210, 10, 110}, true);
    RCShdPtr<UiLabel> const title = UiLabel::create(floating, "titleBar", nullptr);
    title->getLabel().setString("Awards");
    UiEventCallback<ScreenReader> move(this, nullptr);
    title->setPointerMoveCb(&move);
    main->show();
    EXPECT_EQ(nameOf("float"), "Awards");
    title->getLabel().setString("Votes");
    EXPECT_EQ(nameOf("float"), "Votes");
    floating->clearParent();
}
