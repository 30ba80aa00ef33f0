#include "platform/extension/window/private/CardAccessibility.h"

#include "WindowWorld.h"

#include <QAccessible>
#include <gmock/gmock.h>

namespace orvo {
namespace {

using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using testing::Mode;
using testing::WindowWorld;

/// What assistive tools are told, as text.
std::vector<std::string>& told() {
    static std::vector<std::string> events;
    return events;
}

std::string nameOf(QAccessibleInterface* interface) {
    return interface ? interface->text(QAccessible::Name).toStdString() : "nothing";
}

void note(QAccessibleEvent& event) {
    const auto name = nameOf(event.accessibleInterface());
    switch (event.type()) {
    case QAccessible::Focus:
        return told().push_back("focus " + name);
    case QAccessible::NameChanged:
        return told().push_back("name " + name);
    case QAccessible::ObjectCreated:
        return told().push_back("created " + name);
    case QAccessible::ObjectDestroyed:
        return told().push_back("destroyed");
    default:
        return;
    }
}

struct AccessibleWorld : WindowWorld {
    AccessibleWorld() {
        show();
        told().clear();
    }

    static QAccessibleInterface* root() { return toolkitWindow().accessibleRoot(); }
    QAccessibleInterface* list() { return root()->child(root()->childCount() - 1); }
    QAccessibleInterface* row(int index) { return list()->child(index); }
    QAccessibleInterface* button() { return root()->child(1); }
    std::vector<std::string> taken() {
        settle();
        return std::exchange(told(), {});
    }

    bool isHeard = true;
    EnvironmentSlot<CardAccessibility::Audience>::Override audience =
        CardAccessibility::audience().overrideWith({[this] { return isHeard; }, note});
};

class CardAccessibilityTest : public ::testing::Test {
protected:
    void SetUp() override {
        if (!testing::haveGraphicalApplication())
            GTEST_SKIP() << "another test has made the application object";
    }
};

TEST_F(CardAccessibilityTest, ApplicationHoldsTheWindowAndTheWindowItsParts) {
    AccessibleWorld world;
    auto* const application = QAccessible::queryAccessibleInterface(qApp);
    ASSERT_EQ(application->childCount(), 1);
    auto* const root = application->child(0);
    EXPECT_EQ(root, world.root());
    EXPECT_EQ(root->role(), QAccessible::Window);
    EXPECT_EQ(nameOf(root), "A Widget");
    ASSERT_EQ(root->childCount(), 3);
    EXPECT_EQ(root->child(0)->role(), QAccessible::StaticText);
    EXPECT_EQ(nameOf(root->child(0)), "A Widget");
    EXPECT_EQ(root->child(1)->role(), QAccessible::Button);
    EXPECT_EQ(root->child(2)->role(), QAccessible::List);
    EXPECT_EQ(root->child(3), nullptr);
    for (int index = 0; index < 3; ++index) {
        EXPECT_EQ(root->indexOfChild(root->child(index)), index);
        EXPECT_EQ(root->child(index)->parent(), root);
    }
}

TEST_F(CardAccessibilityTest, RowsSayWhatIsSpokenForThem) {
    AccessibleWorld world;
    world.expand();
    ASSERT_EQ(world.list()->childCount(), 3);
    EXPECT_EQ(world.row(1)->role(), QAccessible::ListItem);
    EXPECT_EQ(nameOf(world.row(1)), "green spoken");
    EXPECT_EQ(world.row(1)->parent(), world.list());
    EXPECT_EQ(world.list()->indexOfChild(world.row(1)), 1);
    EXPECT_EQ(world.row(3), nullptr);
}

TEST_F(CardAccessibilityTest, PartsStandWhereTheyAreOnTheScreen) {
    AccessibleWorld world;
    world.toolkitWindow().setPosition(50, 60);
    world.expand();
    EXPECT_EQ(world.row(1)->rect(), QRect(50, 60 + 36 + 110, 359, 110));
    EXPECT_EQ(world.list()->rect(), QRect(50, 96, 359, 330));
    EXPECT_EQ(world.list()->childAt(60, 60 + 36 + 120), world.row(1));
    EXPECT_EQ(world.root()->childAt(400, 70), world.button());
}

TEST_F(CardAccessibilityTest, ActionsDoWhatAPressDoes) {
    AccessibleWorld world;
    auto* const action = world.row(0)->actionInterface();
    ASSERT_TRUE(action);
    EXPECT_TRUE(action->actionNames().contains(QAccessibleActionInterface::pressAction()));
    action->doAction(QAccessibleActionInterface::pressAction());
    EXPECT_THAT(world.widget->pressed, ElementsAre("red"));
    world.button()->actionInterface()->doAction(QAccessibleActionInterface::pressAction());
    EXPECT_EQ(world.host->displayMode(), Mode::Expanded);
    EXPECT_EQ(world.list()->actionInterface(), nullptr);
}

TEST_F(CardAccessibilityTest, RowThatDoesNothingHasNoPress) {
    AccessibleWorld world;
    world.widget->show({"dead", "green"});
    world.settle();
    EXPECT_FALSE(world.row(0)->actionInterface()->actionNames().contains(
        QAccessibleActionInterface::pressAction()));
}

TEST_F(CardAccessibilityTest, TellsWhereTheFocusGoes) {
    AccessibleWorld world;
    world.toolkitWindow().requestActivate();
    world.taken();
    world.expand();
    world.taken();
    world.key(Qt::Key_Tab);
    EXPECT_THAT(world.taken(), ElementsAre("focus red spoken"));
    EXPECT_TRUE(world.row(0)->state().focused);
    EXPECT_EQ(world.root()->focusChild(), world.row(0));
    world.key(Qt::Key_Down);
    EXPECT_THAT(world.taken(), ElementsAre("focus green spoken"));
    EXPECT_FALSE(world.row(0)->state().focused);
    world.key(Qt::Key_Tab);
    EXPECT_EQ(world.taken().size(), 1U);
    EXPECT_TRUE(world.button()->state().focused);
}

TEST_F(CardAccessibilityTest, ToolsCanMoveTheFocus) {
    AccessibleWorld world;
    world.toolkitWindow().requestActivate();
    world.expand();
    world.row(2)->actionInterface()->doAction(QAccessibleActionInterface::setFocusAction());
    world.settle();
    EXPECT_EQ(world.widget->table->focusedIndexPath()->row(), 2);
    EXPECT_TRUE(world.row(2)->state().focused);
}

TEST_F(CardAccessibilityTest, TellsWhatHasANewName) {
    AccessibleWorld world;
    world.expand();
    world.taken();
    world.widget->show({"red", "yellow", "blue"});
    EXPECT_THAT(world.taken(), ElementsAre("name yellow spoken"));
}

TEST_F(CardAccessibilityTest, TellsOfRowsThatComeAndGo) {
    AccessibleWorld world;
    const auto title = nameOf(world.button());
    world.expand();
    const auto grown = world.taken();
    EXPECT_THAT(grown, Contains("created green spoken"));
    EXPECT_THAT(grown, Contains("created blue spoken"));
    EXPECT_THAT(grown, Contains("name " + nameOf(world.button())));
    EXPECT_NE(nameOf(world.button()), title);
    world.widget->show({"red"});
    EXPECT_THAT(world.taken(), Contains("destroyed").Times(3)) << "two rows and the button";
    EXPECT_EQ(world.root()->childCount(), 2);
}

TEST_F(CardAccessibilityTest, RowsOutOfSightAreThereAndSaySo) {
    AccessibleWorld world;
    world.widget->show(std::vector<std::string>(20, "row"));
    world.settle();
    world.expand();
    ASSERT_EQ(world.list()->childCount(), 20);
    EXPECT_FALSE(world.row(0)->state().offscreen);
    EXPECT_TRUE(world.row(19)->state().offscreen);
    world.row(19)->actionInterface()->doAction(QAccessibleActionInterface::setFocusAction());
    world.settle();
    EXPECT_FALSE(world.row(19)->state().offscreen);
    EXPECT_EQ(nameOf(world.row(19)), "row spoken");
}

TEST_F(CardAccessibilityTest, NothingIsToldWhereNobodyListens) {
    AccessibleWorld world;
    world.isHeard = false;
    world.widget->show({"yellow"});
    EXPECT_THAT(world.taken(), IsEmpty());
}

} // namespace
} // namespace orvo
