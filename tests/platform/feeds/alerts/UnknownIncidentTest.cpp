#include "platform/feeds/alerts/UnknownIncident.h"

#include "platform/foundation/Hashing.h"
#include "platform/geoservices/TransitIncidentAffectedEntity.h"

#include <gtest/gtest.h>

namespace orvo::testing {

namespace {

constexpr double Now = 1750000000;
const UnknownLine Line{"town", 7, "Metro", "Europe/Paris"};

std::shared_ptr<FeedTransitIncident> unknown(const UnknownStatus& status,
                                             const UnknownLine& line = Line,
                                             const std::string& language = "en",
                                             double now = Now) {
    return makeUnknownIncident(line, status, now, language);
}

} // namespace

TEST(UnknownIncident, NamesTheSystemAndTheAge) {
    const auto incident = unknown({UnknownStatus::Reason::SourceFailed, Now - 2100, "timed out"});
    EXPECT_EQ(incident->title(), "Status unknown");
    EXPECT_EQ(incident->summary(), "Metro, last known 35 minutes ago");
    EXPECT_EQ(
        incident->fullDescription(),
        "Metro, last known 35 minutes ago\n\nThe service alerts could not be read: timed out");
    EXPECT_EQ(incident->messageForRoutePlanning(), "Status unknown");
    EXPECT_EQ(incident->messageForRouteStepping(), "Status unknown");
    EXPECT_EQ(incident->messageForNonRoutable(), "Status unknown");
}

TEST(UnknownIncident, HasNoDates) {
    const auto incident = unknown({UnknownStatus::Reason::SourceFailed, Now, ""});
    EXPECT_EQ(incident->startDate(), nullptr);
    EXPECT_EQ(incident->endDate(), nullptr);
    EXPECT_EQ(incident->creationDate(), nullptr);
    EXPECT_EQ(incident->lastUpdated(), nullptr);
}

TEST(UnknownIncident, SaysThatItIsUnknownAndBlocksNothing) {
    const auto incident = unknown({UnknownStatus::Reason::SourceFailed, std::nullopt, ""});
    EXPECT_TRUE(incident->details().isUnknown);
    EXPECT_FALSE(incident->isBlockingIncident());
    EXPECT_EQ(incident->details().feed, "town");
    EXPECT_EQ(incident->details().timeZone, "Europe/Paris");
    EXPECT_EQ(incident->iconType(), 8);
    const auto entities = typed<TransitIncidentAffectedEntity>(incident->affectedEntities());
    ASSERT_EQ(entities.size(), 1U);
    EXPECT_EQ(entities[0]->muid(), 7U);
    EXPECT_EQ(entities[0]->nextStopIDs(), nullptr);
}

TEST(UnknownIncident, ItsNumberIsOfFeedAndLineAlone) {
    const UnknownStatus failed{UnknownStatus::Reason::SourceFailed, Now - 5, "x"};
    const UnknownStatus lost{UnknownStatus::Reason::SelectorLost, std::nullopt, ""};
    EXPECT_EQ(unknown(failed)->muid(), unknown(lost, Line, "de", Now + 9)->muid());
    EXPECT_NE(unknown(failed)->muid(), unknown(failed, {"town", 8, "Metro", ""})->muid());
    EXPECT_NE(unknown(failed)->muid(), unknown(failed, {"city", 7, "Metro", ""})->muid());
    EXPECT_NE(unknown(failed)->muid(), 0U);
}

TEST(UnknownIncident, ItsNumberStaysForItIsThatOfFeedLineAndTheWordUnknown) {
    const UnknownStatus failed{UnknownStatus::Reason::SourceFailed, Now, ""};
    const std::string_view content("town\0"
                                   "7\0"
                                   "unknown",
                                   14);
    EXPECT_EQ(unknown(failed)->muid(), stableHash(content));
}

TEST(UnknownIncident, SaysWhy) {
    using Reason = UnknownStatus::Reason;
    const auto why = [](Reason reason) {
        return unknown({reason, std::nullopt, ""})->fullDescription().value_or("");
    };
    EXPECT_TRUE(why(Reason::SourceFailed).ends_with("The service alerts could not be read."));
    EXPECT_TRUE(why(Reason::SelectorLost).ends_with("It may concern this line."));
    EXPECT_TRUE(why(Reason::LineDeparted).ends_with("not in the current schedule."));
    EXPECT_TRUE(why(Reason::ScheduleUnread).ends_with("The schedule could not be read."));
    EXPECT_TRUE(why(Reason::NothingToAsk).ends_with("no source of service alerts for this line."));
}

TEST(UnknownIncident, TheCauseStandsBehindAColonForItMayBeNoSentence) {
    using Reason = UnknownStatus::Reason;
    const auto why = [](Reason reason, const char* cause) {
        return unknown({reason, std::nullopt, cause})->fullDescription().value_or("");
    };
    EXPECT_TRUE(why(Reason::SourceFailed, "it is empty")
                    .ends_with("\n\nThe service alerts could not be read: it is empty"));
    EXPECT_TRUE(why(Reason::ScheduleUnread, "/a/b: disk I/O error")
                    .ends_with("\n\nThe schedule could not be read: /a/b: disk I/O error"));
    EXPECT_TRUE(why(Reason::SelectorLost, "The schedule could not be asked.")
                    .ends_with("It may concern this line.\n\nThe schedule could not be asked."));
}

TEST(UnknownIncident, AnAgeIsNeverNegative) {
    EXPECT_EQ(unknown({UnknownStatus::Reason::SourceFailed, Now + 500, ""})->summary(),
              "Metro, last known less than a minute ago");
}

TEST(UnknownIncident, IsInThePersonsLanguage) {
    const auto incident =
        unknown({UnknownStatus::Reason::SourceFailed, Now - 7200, ""}, Line, "de-DE");
    EXPECT_EQ(incident->title(), "Status unbekannt");
    EXPECT_EQ(incident->summary(), "Metro, zuletzt bekannt vor 2 Stunden");
}

} // namespace orvo::testing
