#include "print/PrintedTarget.h"

#include "handoff/NSURLOWOpenable.h"
#include "handoff/OWUserActivityData.h"
#include "platform/foundation/NSData.h"
#include "print/PrintWorld.h"
#include "viewmodel/OWTransitIncidentsDataSourceBuilder.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using Builder = OWTransitIncidentsDataSourceBuilder;
using testing::incident;

class PrintedTargetTest : public ::testing::Test {
protected:
    static PrintedTarget activity(const char* key, std::string_view bytes) {
        return *PrintedTarget::of(OWUserActivityData::initWithActivityType_userInfo(
            "a.b", NSDictionary::dictionaryWithTextKeys({{key, NSData::dataWithString(bytes)}})));
    }

    testing::PrintWorld world;
};

TEST_F(PrintedTargetTest, NothingIsOpenedByARowThatCannotBeTapped) {
    EXPECT_FALSE(PrintedTarget::of(nullptr));
}

TEST_F(PrintedTargetTest, AURLIsItsText) {
    const auto target =
        PrintedTarget::of(NSURLOWOpenable::openableWithURL(NSURL::URLWithString("orvo://?t=r")));
    EXPECT_EQ(target->url, "orvo://?t=r");
    EXPECT_FALSE(target->userInfo);
    EXPECT_EQ(target->text(), "orvo://?t=r");
}

TEST_F(PrintedTargetTest, AnIncidentNamesItsLineFromTheBytesHandedOver) {
    const auto target = PrintedTarget::of(
        Builder::_userActivityDataForLineItem(testing::line(18446744073709551615U, "U1", {})));
    EXPECT_FALSE(target->url);
    EXPECT_EQ(target->activityType, "com.zentu.Orvo.Transit.Incident");
    EXPECT_EQ(target->lineMuid, 18446744073709551615U);
    EXPECT_FALSE(target->incidentMuids);
    EXPECT_EQ(target->text(), "com.zentu.Orvo.Transit.Incident: line 18446744073709551615");
}

TEST_F(PrintedTargetTest, TheVeryBytesOfTheRowBeforeAreNotReadAgain) {
    const auto openable = Builder::_userActivityDataForLineItem(testing::line(7, "U1", {}));
    auto before = *PrintedTarget::of(openable);
    before.lineMuid = 99; // so that it is seen where the number comes from
    EXPECT_EQ(PrintedTarget::of(openable, &before)->lineMuid, 99U);
    const auto other = Builder::_userActivityDataForLineItem(testing::line(7, "U1", {}));
    EXPECT_EQ(PrintedTarget::of(other, &before)->lineMuid, 7U);
    const auto url =
        PrintedTarget::of(NSURLOWOpenable::openableWithURL(NSURL::URLWithString("a:b")));
    EXPECT_EQ(PrintedTarget::of(other, &*url)->lineMuid, 7U);
}

TEST_F(PrintedTargetTest, AnIncidentListNamesItsIncidentsInOrder) {
    const auto target =
        PrintedTarget::of(Builder::_activityDataForIncidents({incident(9), incident(2)}));
    EXPECT_EQ(target->incidentMuids, (std::vector<std::uint64_t>{9, 2}));
    EXPECT_FALSE(target->lineMuid);
    EXPECT_EQ(target->text(), "com.zentu.Orvo.Transit.IncidentList: 2 incidents");
    EXPECT_EQ(PrintedTarget::of(Builder::_activityDataForIncidents({incident(9)}))->text(),
              "com.zentu.Orvo.Transit.IncidentList: 1 incident");
}

TEST_F(PrintedTargetTest, BytesThatCannotBeReadNameNothing) {
    const auto incidentActivity = activity("bs", "no bzip2");
    EXPECT_FALSE(incidentActivity.lineMuid);
    EXPECT_EQ(incidentActivity.text(), "a.b");
    EXPECT_FALSE(activity("incidentListKey", "no archive").incidentMuids);
}

TEST_F(PrintedTargetTest, AnActivityWithoutUserInfoIsItsTypeAlone) {
    const auto target =
        PrintedTarget::of(OWUserActivityData::initWithActivityType_userInfo("a.b", nullptr));
    EXPECT_EQ(target->text(), "a.b");
}

} // namespace
} // namespace orvo
