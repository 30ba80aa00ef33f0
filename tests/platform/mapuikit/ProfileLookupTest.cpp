#include "platform/favorites/FavoritesStore.h"
#include "platform/feeds/FeedRegistry.h"
#include "platform/feeds/ScheduleUpdater.h"
#include "platform/feeds/TravelPreferences.h"
#include "platform/feeds/schedule/LineMaker.h"
#include "platform/feeds/schedule/ScheduleStore.h"
#include "platform/foundation/RunLoop.h"
#include "platform/geoservices/FeedTransitIncident.h"
#include "platform/geoservices/TransitLineItem.h"
#include "platform/mapuikit/FeedLookupService.h"
#include "support/AlertMessage.h"
#include "support/SmallSchedule.h"
#include "support/TemporaryProfile.h"
#include "support/TestClock.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <fstream>

namespace orvo {
namespace {

using testing::alertMessage;
using ::testing::ElementsAre;

/// The whole way on files of a profile: registry, schedules, favourites, preferences, loader.
class ProfileLookup : public ::testing::Test {
protected:
    static constexpr std::uint64_t Now = 1'750'000'000;

    ProfileLookup() {
        FeedConfiguration feed;
        feed.name = "city";
        feed.schedule.location =
            testing::writeSchedule(profile.path() / "schedule", {"1", "2"}).string();
        feed.alerts.resize(1);
        feed.alerts[0].location = (profile.path() / "alerts.pb").string();
        EXPECT_EQ(descriptionOf(FeedRegistry::open()->add(feed)), "(null)");
        EXPECT_EQ(descriptionOf(schedules()->importSchedule(
                      "city", ScheduleSource::fromPath(profile.path() / "schedule"), {}, nullptr)),
                  "(null)");
    }
    static std::shared_ptr<ScheduleStore> schedules() {
        return ScheduleStore::open(ScheduleStore::defaultPath(), nullptr);
    }
    void publish(const std::vector<testing::AlertEntity>& entities) const {
        std::ofstream(profile.path() / "alerts.pb", std::ios::binary)
            << alertMessage(Now, entities)->stringView();
    }
    /// Each line's name and the titles of its incidents; the error in place of all.
    static std::vector<std::string> lookUp(const std::vector<std::uint64_t>& muids) {
        NSArray::Elements identifiers;
        for (const auto muid : muids)
            identifiers.push_back(MapItemIdentifier::identifierWithMuid(muid));
        std::vector<std::string> rows;
        bool isAnswered = false;
        FeedLookupService::init()
            ->ticketForTransitLines_traits(NSArray::arrayWithObjects(identifiers), nullptr)
            ->submitWithHandler_networkActivity(
                [&](const std::shared_ptr<NSArray>& items, const std::shared_ptr<NSError>& error) {
                    isAnswered = true;
                    if (error)
                        rows.push_back(error->localizedDescription());
                    for (const auto& item : typed<TransitLineItem>(items))
                        rows.push_back(row(*item));
                },
                nullptr);
        EXPECT_TRUE(RunLoop::main().runUntil([&] { return isAnswered; }, 10));
        return rows;
    }
    static std::string row(const TransitLineItem& item) {
        auto text = item.name().value_or("(null)") + ":";
        for (const auto& incident : typed<FeedTransitIncident>(item.incidents()))
            text +=
                incident->details().isUnknown ? " unknown" : " " + incident->title().value_or("");
        return text;
    }

    testing::TemporaryProfile profile;
    testing::StoppedClock clock{static_cast<double>(Now)};
    EnvironmentSlot<bool>::Override noChecks = ScheduleUpdater::checksDaily().overrideWith(false);
};

TEST_F(ProfileLookup, AnswersFromTheFilesOfTheProfile) {
    publish({{.routes = {"2"}, .header = "Works"}});
    EXPECT_THAT(lookUp({lineMuid("city", "2"), lineMuid("city", "1")}),
                ElementsAre("Line 2: Works", "Line 1:"));
}

TEST_F(ProfileLookup, HeedsTheStepFreePreference) {
    constexpr std::int32_t AccessibilityIssue = 11;
    publish({{.routes = {"1"}, .header = "Lift", .effect = AccessibilityIssue}});
    EXPECT_THAT(lookUp({lineMuid("city", "1")}), ElementsAre("Line 1:"));
    EXPECT_EQ(TravelPreferences::setAsksForStepFree(true), nullptr);
    EXPECT_THAT(lookUp({lineMuid("city", "1")}), ElementsAre("Line 1: Lift"));
}

TEST_F(ProfileLookup, ASourceThatIsGoneIsAnErrorThatNamesFeedAndFile) {
    const auto rows = lookUp({lineMuid("city", "1")});
    ASSERT_EQ(rows.size(), 1U);
    EXPECT_THAT(rows[0], ::testing::HasSubstr("city"));
    EXPECT_THAT(rows[0], ::testing::HasSubstr("alerts.pb"));
}

TEST_F(ProfileLookup, AFavoriteThatNoScheduleKnowsIsShownFromItsKeptCopy) {
    publish({});
    ScheduleLine line;
    line.feed = "gone";
    line.routeId = "9";
    line.shortName = "N9";
    line.muid = lineMuid("gone", "9");
    EXPECT_EQ(
        FavoritesStore::open(FavoritesStore::standardPath(), FavoritesStore::Access::Write, nullptr)
            ->addLine(*makeTransitLine(line)),
        nullptr);
    EXPECT_THAT(lookUp({line.muid, lineMuid("city", "1")}), ElementsAre("N9: unknown", "Line 1:"));
}

} // namespace
} // namespace orvo
