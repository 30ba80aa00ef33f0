#include "orvo/HandOffJson.h"

#include "orvo/CommandTest.h"
#include "orvo/HandOffStore.h"
#include "orvo/HandOffWorld.h"
#include "platform/feeds/schedule/ScheduleStore.h"

#include <gmock/gmock.h>

namespace orvo {
namespace {

using ::testing::HasSubstr;

class HandOffJsonTest : public testing::CommandTest {
protected:
    /// As if it were handed over now.
    static void take(const std::shared_ptr<NSData>& activity) {
        EXPECT_FALSE(HandOffStore::keep(HandOff::ofActivity(activity)));
    }

    EnvironmentSlot<std::shared_ptr<const CodingClassTable>>::Override classes =
        CodingClassTable::current().overrideWith(testing::storableClasses());
};

TEST_F(HandOffJsonTest, ScriptsGetTheLineWithItsWholeIncidents) {
    take(testing::tapOnLine(testing::lineWith({testing::feedIncident(1, "Works")})));
    EXPECT_EQ(answered({"show", "--json"}), R"json({
  "received": "2025-06-15T15:06:40Z",
  "kind": "line",
  "line": {
    "feed": null,
    "route_id": null,
    "muid": "7",
    "name": "U1",
    "system": "Metro"
  },
  "incidents": [
    {
      "muid": "1",
      "title": "Works",
      "summary": "Short.",
      "start": "2025-06-15T14:36:40Z",
      "end": "2025-06-15T16:06:40Z",
      "severity": "UNKNOWN_SEVERITY",
      "effect": "UNKNOWN_EFFECT",
      "part": false,
      "unknown": false,
      "description": "First paragraph.\n\nSecond paragraph.",
      "link": "https://t.example/i",
      "lines": [
        "7",
        "8"
      ]
    }
  ],
  "error": null
}
)json");
}

TEST_F(HandOffJsonTest, ScriptsGetAListOfIncidentsInItsOrder) {
    const auto bare = TransitIncidentRecord::initWithFields({.muid = 1, .title = "Works"});
    take(testing::tapOnIncidents({testing::feedIncident(2, "Fire"), bare}));
    const auto json = answered({"show", "--json"});
    EXPECT_THAT(json, HasSubstr("\"kind\": \"incidents\",\n  \"line\": null,\n"));
    EXPECT_LT(json.find("\"title\": \"Fire\""), json.find("\"title\": \"Works\""));
    EXPECT_THAT(json,
                HasSubstr("\"description\": null,\n"
                          "      \"link\": null,\n"
                          "      \"lines\": []\n"));
}

TEST_F(HandOffJsonTest, ScriptsLearnWhereALineComesFrom) {
    addCity();
    const auto store = ScheduleStore::open(ScheduleStore::defaultPath(), nullptr);
    const auto muid = store->lines("city").front().muid;
    take(testing::tapOnLine(TransitLineItemRecord::initWithFields_service(
        {.muid = muid, .name = "M1"}, {.incidents = NSArray::array()})));
    EXPECT_THAT(answered({"show", "--json"}), HasSubstr("\"feed\": \"city\",\n"));
}

TEST_F(HandOffJsonTest, ScriptsGetAllMembersWhateverThereIs) {
    const std::string rest = "  \"line\": null,\n  \"incidents\": [],\n  \"error\": null\n}\n";
    EXPECT_EQ(answered({"show", "--json"}), "{\n  \"received\": null,\n  \"kind\": null,\n" + rest);
    EXPECT_FALSE(HandOffStore::keep(HandOff::ofURL("orvo://?t=r")));
    EXPECT_EQ(answered({"show", "--json"}),
              "{\n  \"received\": \"2025-06-15T15:06:40Z\",\n  \"kind\": \"favorites\",\n" + rest);
    write("state/hand-off.plist", "junk");
    const auto unreadable = run({"show", "--json"});
    EXPECT_EQ(unreadable.code, ExitCode::Failed);
    EXPECT_THAT(unreadable.output, HasSubstr("\"kind\": null"));
    EXPECT_THAT(unreadable.output, HasSubstr("\"message\": "));
    EXPECT_THAT(unreadable.error, HasSubstr("hand-off.plist"));
}

} // namespace
} // namespace orvo
