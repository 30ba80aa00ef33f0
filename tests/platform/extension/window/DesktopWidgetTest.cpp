#include "platform/extension/window/DesktopWidget.h"

#include "WindowWorld.h"
#include "platform/extension/window/DesktopApplication.h"

#include <gmock/gmock.h>

namespace orvo {
namespace {

using testing::TableWidget;
using testing::WindowWorld;

/// Events that the test makes.
class ScriptedEvents final : public SystemEvents {
public:
    void start(Handlers given) override { handlers = std::move(given); }
    void stop() override { handlers = {}; }

    Handlers handlers;
};

struct DesktopWorld {
    DesktopWorld() { DesktopAppearance{.isDark = true, .textScale = 1.25}.remember(); }
    void start() {
        desktop.emplace(extension, WidgetHostSettings(), [this] {
            ++closed;
            desktop.reset();
        });
        for (int times = 0; times < 4; ++times)
            RunLoop::main().runOnce();
    }

    testing::TemporaryProfile profile;
    testing::StoppedClock clock;
    EnvironmentSlot<UITraitCollection>::Override traits =
        UITraitCollection::system().overrideWith({});
    std::shared_ptr<TableWidget> widget = std::make_shared<TableWidget>();
    Extension extension{{.bundleIdentifier = "a.widget", .displayName = "A Widget"}, [this] {
                            return widget;
                        }};
    std::shared_ptr<ScriptedEvents> events = std::make_shared<ScriptedEvents>();
    EnvironmentSlot<std::function<std::shared_ptr<SystemEvents>()>>::Override factory =
        SystemEvents::factory().overrideWith([this] { return events; });
    std::optional<DesktopWidget> desktop;
    int closed = 0;
};

class DesktopWidgetTest : public ::testing::Test {
protected:
    void SetUp() override {
        makeDesktopApplication("com.zentu.Orvo.TransitWidget");
        if (!testing::haveGraphicalApplication())
            GTEST_SKIP() << "another test has made the application object";
    }
};

TEST_F(DesktopWidgetTest, BeginsWithTheLooksThatWereRemembered) {
    DesktopWorld world;
    world.start();
    const auto traits = UITraitCollection::system().get();
    EXPECT_EQ(traits.userInterfaceStyle, UIUserInterfaceStyle::Dark);
    EXPECT_EQ(traits.preferredContentSizeCategory, UIContentSizeCategory::XXL);
    EXPECT_EQ(WindowWorld::colorAt({180, 3}).name(), "#1e1e22");
}

TEST_F(DesktopWidgetTest, FollowsLockSleepNetworkAndMemory) {
    DesktopWorld world;
    world.start();
    EXPECT_EQ(world.widget->appearances, 1);
    ASSERT_TRUE(world.events->handlers.lockDidChange);
    world.events->handlers.lockDidChange(true);
    EXPECT_EQ(world.widget->disappearances, 1);
    world.events->handlers.lockDidChange(false);
    EXPECT_EQ(world.widget->appearances, 2);
    const auto asked = world.widget->handlers.size();
    world.events->handlers.machineDidWake();
    world.events->handlers.networkDidChange();
    for (int times = 0; times < 4; ++times)
        RunLoop::main().runOnce();
    EXPECT_GT(world.widget->handlers.size(), asked);
    world.events->handlers.memoryIsScarce();
    EXPECT_EQ(world.widget->memoryWarnings, 1);
}

TEST_F(DesktopWidgetTest, MayGoWhenItsWindowIsClosed) {
    DesktopWorld world;
    world.start();
    WindowWorld::toolkitWindow().close();
    RunLoop::main().runOnce();
    EXPECT_EQ(world.closed, 1);
    EXPECT_FALSE(world.desktop);
    EXPECT_EQ(world.widget->disappearances, 1);
    EXPECT_FALSE(world.events->handlers.lockDidChange);
}

TEST_F(DesktopWidgetTest, AsksNobodyBeforeTheFirstFrame) {
    DesktopWorld world;
    world.desktop.emplace(world.extension, WidgetHostSettings(), [] {});
    EXPECT_FALSE(world.events->handlers.lockDidChange);
    EXPECT_EQ(world.widget->appearances, 0);
}

} // namespace
} // namespace orvo
