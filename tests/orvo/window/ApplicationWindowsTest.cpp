#include "orvo/window/ApplicationWindows.h"

#include "orvo/window/WindowWorld.h"
#include "platform/foundation/RunLoop.h"
#include "platform/settings/DesktopAppearance.h"

#include <QWidget>

namespace orvo {
namespace {

class ApplicationWindowsTest : public testing::WindowTest {
protected:
    void SetUp() override {
        ASSERT_TRUE(testing::haveWindowApplication());
        (void)RunLoop::main();
        windows.emplace();
        windows->setAllClosed([this] { ++timesClosed; });
    }

    static QWidget* window(const char* name) {
        for (auto* widget : QApplication::topLevelWidgets()) {
            if (widget->objectName() == name)
                return widget;
        }
        return nullptr;
    }
    static std::shared_ptr<FavoritesEditor> editor() {
        return std::make_shared<FavoritesEditor>(
            [](FavoritesStore::Access access, std::shared_ptr<NSError>& error) {
                return FavoritesStore::open(FavoritesStore::standardPath(), access, &error);
            });
    }

    std::optional<ApplicationWindows> windows;
    int timesClosed = 0;
};

TEST_F(ApplicationWindowsTest, AreNotOpenBeforeThereIsSomethingToShow) {
    EXPECT_FALSE(windows->isAnyOpen());
    EXPECT_FALSE(window("incidents")->isVisible());
    EXPECT_FALSE(window("favorites")->isVisible());
}

TEST_F(ApplicationWindowsTest, OneWindowShowsWhatWasHandedOverLast) {
    windows->show(pageOfLine({}), {});
    EXPECT_TRUE(window("incidents")->isVisible());
    EXPECT_EQ(window("incidents")->windowTitle(), "U1 · Metro");
    windows->show(pageOfIncidents({testing::feedIncident(1, "Fire")}), "token");
    EXPECT_EQ(window("incidents")->windowTitle(), "1 incident");
    EXPECT_FALSE(window("favorites")->isVisible());
}

TEST_F(ApplicationWindowsTest, TheLastThatIsClosedIsTold) {
    windows->show(pageOfLine({}), {});
    windows->show(editor(), {});
    EXPECT_TRUE(window("favorites")->isVisible());
    window("incidents")->close();
    QCoreApplication::processEvents();
    EXPECT_EQ(timesClosed, 0);
    EXPECT_TRUE(windows->isAnyOpen());
    window("favorites")->close();
    QCoreApplication::processEvents();
    EXPECT_EQ(timesClosed, 1);
    EXPECT_FALSE(windows->isAnyOpen());
}

TEST_F(ApplicationWindowsTest, BeginWithTheLooksThatTheDesktopHadLast) {
    windows.reset();
    DesktopAppearance{.isDark = true}.remember();
    windows.emplace();
    EXPECT_EQ(QApplication::palette().color(QPalette::Window), QColor(0x1E, 0x1E, 0x22));
}

TEST_F(ApplicationWindowsTest, ReadFromRightToLeftWhereThePersonDoes) {
    windows.reset();
    const auto arabic = Text::locale().overrideWith("ar");
    windows.emplace();
    windows->show(pageOfLine({}), {});
    EXPECT_EQ(window("incidents")->layoutDirection(), Qt::RightToLeft);
}

} // namespace
} // namespace orvo
