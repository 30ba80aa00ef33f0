// The captured and hostile schedules outside the repository.
#include "TestSchedules.h"
#include "platform/feeds/schedule/LineMaker.h"
#include "platform/feeds/schedule/ScheduleStore.h"
#include "platform/foundation/Text.h"
#include "support/TemporaryProfile.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace orvo {
namespace {

using ::testing::HasSubstr;

class CapturedSchedules : public ::testing::Test {
protected:
    void SetUp() override {
        if (feeds.empty())
            GTEST_SKIP() << "ORVO_TEST_FEEDS names no folder";
    }
    /// Why it was refused; empty when it was imported.
    std::string import(const std::string& file) {
        const auto error =
            store->importSchedule("feed", ScheduleSource::fromPath(feeds / file), {}, &report);
        lines = store->lines("feed");
        return error ? error->localizedDescription() : "";
    }
    const ScheduleLine& line(const std::string& routeId) {
        for (const auto& line : lines)
            if (line.routeId == routeId)
                return line;
        throw std::runtime_error("no line " + routeId);
    }

    std::filesystem::path feeds = testing::capturedFeeds();
    testing::TemporaryFolder folder;
    EnvironmentSlot<std::string>::Override locale = Text::locale().overrideWith("en-US");
    std::shared_ptr<ScheduleStore> store =
        ScheduleStore::open(folder.path() / "schedules.sqlite", nullptr);
    ImportReport report;
    std::vector<ScheduleLine> lines;
};

TEST_F(CapturedSchedules, Boston) {
    ASSERT_EQ(import("mbta-2024/static.zip"), "");
    EXPECT_EQ(lines.size(), 380U);
    EXPECT_TRUE(report.notes.empty());
    EXPECT_EQ(lines.front().routeId, "Red");
    const auto red = makeTransitLine(line("Red"));
    EXPECT_EQ(red->name(), "Red Line");
    EXPECT_EQ(red->system()->name(), "MBTA");
    EXPECT_FALSE(red->isBus());
    EXPECT_EQ(red->alternateArtwork()->shieldDataSource()->shieldColorString(), "DA291C,FFFFFF");
    const auto info = store->info("feed");
    EXPECT_EQ(info->endDate, "2024-08-24");
    EXPECT_EQ(info->version, "Summer 2024, 2024-07-16T21:12:12+00:00, version D");
    EXPECT_TRUE(info->hasRunOut(1724558400));
    EXPECT_FALSE(info->hasRunOut(1724558399));
    EXPECT_EQ(info->stops, 9969);
    EXPECT_FALSE(info->knowsStopsOfLines);
    EXPECT_EQ(store->search("red line", 1).front().routeId, "Red");
}

TEST_F(CapturedSchedules, Mississauga) {
    ASSERT_EQ(import("miway-2025/static.zip"), "");
    EXPECT_EQ(lines.size(), 66U);
    EXPECT_EQ(line("1").shortName, "1");
    EXPECT_EQ(line("1").longName, "Dundas");
    EXPECT_EQ(line("1").agency.name, "MiWay");
    EXPECT_EQ(store->info("feed")->endDate, "2025-12-21");
}

TEST_F(CapturedSchedules, Montpellier) {
    ASSERT_EQ(import("tam-montpellier-2025/static.zip"), "");
    EXPECT_EQ(line("7-1").shortName, "T1");
    EXPECT_EQ(line("7-1").agency.name, "TAM");
    EXPECT_EQ(store->info("feed")->language, "fr");
    const auto yellow = makeTransitLine(line("7-10"));
    EXPECT_EQ(yellow->alternateArtwork()->shieldDataSource()->shieldColorString(), "FFB900,000000");
}

TEST_F(CapturedSchedules, DetroitTellsWhichLinesServeAStop) {
    ASSERT_EQ(import("detroit-people-mover-2023/static.zip"), "");
    ASSERT_EQ(lines.size(), 1U);
    EXPECT_EQ(basicRouteType(lines[0].routeType), 12);
    EXPECT_EQ(lines[0].agencyId, "");
    EXPECT_EQ(lines[0].agency.name, "Detroit People Mover");
    EXPECT_TRUE(store->info("feed")->knowsStopsOfLines);
    EXPECT_GT(report.stops, 0U);
}

TEST_F(CapturedSchedules, TwoThousandLines) {
    ASSERT_EQ(import("perf/static.zip"), "");
    EXPECT_EQ(lines.size(), 2000U);
    EXPECT_EQ(store->search("1999", 5).front().routeId, "R1999");
}

TEST_F(CapturedSchedules, HostileOnesAreReadOrRefusedWithTheReason) {
    EXPECT_EQ(import("hostile-rt/static.zip"), "");
    EXPECT_EQ(lines.size(), 2U);
    EXPECT_EQ(import("hostile-static/csv-bom-crlf.zip"), "");
    EXPECT_EQ(line("R1").longName, "Center, North \"loop\"");
    EXPECT_EQ(line("R1").agency.name, "Agency One");
    EXPECT_EQ(import("hostile-static/example.zip"), "");
    EXPECT_EQ(lines.size(), 5U);
    EXPECT_EQ(import("hostile-static/example-errors.zip"), "");
    ASSERT_FALSE(report.notes.empty());
    EXPECT_EQ(report.notes.front().reason, "an agency_id that agency.txt does not have");
    const auto before = lines;
    const auto name = [this](const char* file) {
        return (feeds / "hostile-static" / file).string();
    };
    EXPECT_EQ(import("hostile-static/csv-missing-routes.zip"),
              name("csv-missing-routes.zip") + ": holds no routes.txt, so it is no schedule");
    EXPECT_THAT(import("hostile-static/example-nested-two-feeds.zip"),
                HasSubstr("holds more than one schedule, in example1/ and in example2/"));
    for (const char* file : {"example-nested-dir.zip", "example-nested-dir-ambiguous.zip"})
        EXPECT_THAT(import(std::string("hostile-static/") + file),
                    HasSubstr(name(file) +
                              ": its schedule lies too deep, in example-nested-dir/example/;"));
    EXPECT_THAT(import("hostile-static/example-nested-zip.zip"),
                HasSubstr("another archive, example-nested-zip/example.zip"));
    EXPECT_THAT(import("hostile-static/invalid.zip"),
                HasSubstr(name("invalid.zip") + ": is not a zip file; it begins with"));
    EXPECT_EQ(lines, before);
}

} // namespace
} // namespace orvo
