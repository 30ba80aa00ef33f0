#include "orvo/window/LineMark.h"

#include "orvo/window/WindowWorld.h"

#include <algorithm>

namespace orvo {
namespace {

using LineMarkTest = testing::WindowTest;

TEST_F(LineMarkTest, TheScheduleTellsTheLongNameAndTheShield) {
    importCity();
    const auto store = schedules();
    const auto muid = lineMuid("city", "M1");
    const auto mark = LineMark::ofLine(
        *TransitLineItemRecord::initWithFields_service({.muid = muid, .name = "M1"}, {}),
        store.get());
    EXPECT_EQ(mark.name, "M1");
    EXPECT_EQ(mark.title, store->line(muid)->longName);
    EXPECT_EQ(mark.shieldText(), "M1");
}

TEST_F(LineMarkTest, WithoutAScheduleTheNameIsTheTitle) {
    const auto mark = LineMark::ofLine(*testing::lineWith({}), nullptr);
    EXPECT_EQ(mark.title, "U1");
    EXPECT_EQ(mark.detail, "Metro");
    EXPECT_EQ(mark.artwork, nullptr);
    EXPECT_EQ(mark.shieldText(), "");
}

TEST_F(LineMarkTest, ALineWithoutAShieldHasItsSystemsMark) {
    importCity();
    const auto lines = schedules()->lines("city");
    const auto cableCar = std::ranges::find(lines, "Skyline Cable Car", &ScheduleLine::longName);
    ASSERT_NE(cableCar, lines.end());
    const auto mark = LineMark::ofLine(*cableCar);
    EXPECT_EQ(mark.shieldText(), "");
    EXPECT_EQ(mark.pictureText(), "HHR");
}

TEST_F(LineMarkTest, AVoiceSaysNothingTwice) {
    EXPECT_EQ((LineMark{.name = "M1", .title = "Skyline", .detail = "Bay"}.spoken()),
              "M1, Skyline, Bay");
    EXPECT_EQ((LineMark{.name = "M1", .title = "M1", .detail = ""}.spoken()), "M1");
}

} // namespace
} // namespace orvo
