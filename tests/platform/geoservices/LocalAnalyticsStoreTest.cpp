#include "platform/geoservices/LocalAnalyticsStore.h"

#include "support/LogCapture.h"
#include "support/TemporaryProfile.h"
#include "support/TestClock.h"

#include <gtest/gtest.h>

#include <fstream>

namespace orvo {
namespace {

class LocalAnalyticsStoreTest : public ::testing::Test {
protected:
    void addSession(const char* title) {
        const auto record = std::make_shared<TransitWidgetAnalyticsRecord>();
        record->setEverExpanded(true);
        record->setTransitMessageType(3);
        record->setTappedItemIndex(1);
        const auto item = std::make_shared<TransitIncidentAnalyticsItem>();
        item->setTransitLineMuid("18446744073709551615");
        item->setTransitIncidentTitle(title);
        record->addTransitIncidentItem(item);
        store->addWidgetInteraction(2, 1, record, true, NSDate::date(), 12.5);
    }
    std::filesystem::path file() const { return profile.path() / "state" / "analytics.sqlite"; }

    testing::StoppedClock clock;
    testing::TemporaryProfile profile;
    testing::LogCapture log;
    std::shared_ptr<LocalAnalyticsStore> store = std::make_shared<LocalAnalyticsStore>();
};

TEST_F(LocalAnalyticsStoreTest, KeepsASessionWithEverythingItHad) {
    addSession("Lift out of service");
    const auto sessions = LocalAnalyticsStore::sessions(10, nullptr);
    ASSERT_TRUE(sessions);
    ASSERT_EQ(sessions->size(), 1U);
    const auto& session = sessions->front();
    EXPECT_DOUBLE_EQ(session.startedAt, 1750000000);
    EXPECT_DOUBLE_EQ(session.duration, 12.5);
    EXPECT_EQ(session.widgetType, 2);
    EXPECT_EQ(session.endState, 1);
    EXPECT_TRUE(session.wasLocked);
    EXPECT_FALSE(session.initiallyExpanded);
    EXPECT_TRUE(session.everExpanded);
    EXPECT_EQ(session.messageType, 3);
    EXPECT_EQ(session.tappedItemIndex, 1);
    ASSERT_EQ(session.incidents.size(), 1U);
    EXPECT_EQ(session.incidents[0].lineMuid, "18446744073709551615");
    EXPECT_EQ(session.incidents[0].incidentTitle, "Lift out of service");
    EXPECT_TRUE(log.records().empty());
}

TEST_F(LocalAnalyticsStoreTest, AnswersTheNewestFirstAndNoMoreThanAsked) {
    addSession("first");
    addSession("second");
    addSession("third");
    const auto sessions = LocalAnalyticsStore::sessions(2, nullptr);
    ASSERT_TRUE(sessions);
    ASSERT_EQ(sessions->size(), 2U);
    EXPECT_EQ((*sessions)[0].incidents[0].incidentTitle, "third");
    EXPECT_EQ((*sessions)[1].incidents[0].incidentTitle, "second");
}

TEST_F(LocalAnalyticsStoreTest, KeepsUserActions) {
    store->addUserAction(9001, 706, std::nullopt);
    const auto actions = LocalAnalyticsStore::actions(10, nullptr);
    ASSERT_TRUE(actions);
    ASSERT_EQ(actions->size(), 1U);
    EXPECT_EQ(actions->front().action, 9001);
    EXPECT_EQ(actions->front().target, 706);
    EXPECT_DOUBLE_EQ(actions->front().at, 1750000000);
}

TEST_F(LocalAnalyticsStoreTest, NothingRecordedIsEmptyAndMakesNoFile) {
    EXPECT_TRUE(LocalAnalyticsStore::sessions(10, nullptr)->empty());
    EXPECT_TRUE(LocalAnalyticsStore::actions(10, nullptr)->empty());
    EXPECT_FALSE(std::filesystem::exists(file()));
}

TEST_F(LocalAnalyticsStoreTest, WritesNothingWhileWritesStayInMemory) {
    const auto scope = Environment::keepsWritesInMemory().overrideWith(true);
    addSession("never");
    store->addUserAction(10, 706, std::nullopt);
    EXPECT_FALSE(std::filesystem::exists(file()));
}

TEST_F(LocalAnalyticsStoreTest, SessionWithoutARecordIsKeptPlain) {
    store->addWidgetInteraction(2, 2, nullptr, false, nullptr, 0);
    EXPECT_EQ(LocalAnalyticsStore::sessions(10, nullptr)->size(), 1U);
}

TEST_F(LocalAnalyticsStoreTest, UnreadableFileIsAnErrorThatNamesItAndAWriteIsLostWithALogLine) {
    std::filesystem::create_directories(file().parent_path());
    std::ofstream(file()) << std::string(5000, 'x');
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(LocalAnalyticsStore::sessions(10, &error));
    ASSERT_TRUE(error);
    EXPECT_NE(error->localizedDescription().find("analytics.sqlite"), std::string::npos);
    store->addUserAction(10, 706, std::nullopt);
    EXPECT_EQ(log.records().size(), 1U);
}

} // namespace
} // namespace orvo
