#include "orvo/CommandTest.h"
#include "platform/geoservices/LocalAnalyticsStore.h"

#include <gmock/gmock.h>

namespace orvo {
namespace {

using ::testing::HasSubstr;
using ::testing::Not;

class AnalyticsCommandTest : public testing::CommandTest {
protected:
    void record(std::int64_t endState, std::int64_t tapped) {
        const auto session = std::make_shared<TransitWidgetAnalyticsRecord>();
        session->setEverExpanded(true);
        session->setTransitMessageType(3);
        session->setTappedItemIndex(tapped);
        const auto item = std::make_shared<TransitIncidentAnalyticsItem>();
        item->setTransitLineMuid("7");
        item->setTransitIncidentTitle("Works");
        session->addTransitIncidentItem(item);
        store.addWidgetInteraction(2, endState, session, false, NSDate::date(), 12.5);
    }

    LocalAnalyticsStore store;
};

TEST_F(AnalyticsCommandTest, SessionsAreToldInWordsTheNewestFirst) {
    record(1, 4);
    record(2, 0);
    const auto rows = answered({"analytics"});
    EXPECT_THAT(rows, HasSubstr("12.5\tcompact, expanded\tone incident\t1\ttap on row 4\tno\n"));
    EXPECT_LT(rows.find("closed"), rows.find("tap on row 4"));
}

TEST_F(AnalyticsCommandTest, JSONHasEverythingThatWasRecorded) {
    record(1, 4);
    store.addUserAction(9001, 706, std::nullopt);
    EXPECT_EQ(answered({"analytics", "--json"}), R"({
  "sessions": [
    {
      "started": "2025-06-15T15:06:40Z",
      "duration": 12.5,
      "type": 2,
      "end_state": 1,
      "was_locked": false,
      "initially_expanded": false,
      "ever_expanded": true,
      "message_type": 3,
      "tapped_item_index": 4,
      "incidents": [
        {
          "line_muid": "7",
          "title": "Works"
        }
      ]
    }
  ],
  "actions": [
    {
      "at": "2025-06-15T15:06:40Z",
      "action": 9001,
      "target": 706
    }
  ],
  "error": null
}
)");
}

TEST_F(AnalyticsCommandTest, NothingRecordedIsSaidSo) {
    const auto answer = run({"analytics"});
    EXPECT_EQ(answer.code, ExitCode::Answered);
    EXPECT_EQ(answer.output, "");
    EXPECT_THAT(answer.error, HasSubstr("recorded nothing yet"));
    store.addUserAction(9001, 706, std::nullopt);
    EXPECT_THAT(run({"analytics"}).error, HasSubstr("only single actions"));
}

TEST_F(AnalyticsCommandTest, ALimitIsANumberAboveZero) {
    record(1, 4);
    record(2, 0);
    EXPECT_THAT(answered({"analytics", "--limit", "1"}), Not(HasSubstr("tap")));
    for (const char* limit : {"0", "-1", "x", ""})
        EXPECT_THAT(refused({"analytics", std::string("--limit=") + limit}, ExitCode::WrongUsage),
                    HasSubstr("--limit"));
}

TEST_F(AnalyticsCommandTest, ADamagedStoreIsAnErrorInJSONToo) {
    write("state/analytics.sqlite",
          "this is no database at all, but long enough to be read as one");
    const auto answer = run({"analytics", "--json"});
    EXPECT_EQ(answer.code, ExitCode::Failed);
    EXPECT_THAT(answer.output, HasSubstr("\"message\""));
    EXPECT_THAT(answer.error, HasSubstr("analytics.sqlite"));
}

} // namespace
} // namespace orvo
