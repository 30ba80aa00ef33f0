#include "fetching/DebugTransitIncident.h"
#include "fetching/DebugTransitLineItem.h"
#include "handoff/NSDataOrvoExtra.h"
#include "handoff/OrvoActivity.h"
#include "platform/foundation/CodingClass.h"
#include "platform/foundation/NSKeyedUnarchiver.h"
#include "platform/geoservices/TransitLineItemRecord.h"
#include "viewmodel/OWTransitIncidentsDataSourceBuilder.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

/// A made-up incident of the line in the place of its own.
std::shared_ptr<DebugTransitLineItem> debugLine(std::uint64_t muid) {
    const auto line = TransitLineItemRecord::initWithFields_service(
        {.muid = muid, .name = "U" + std::to_string(muid)}, {.incidents = NSArray::array()});
    return DebugTransitLineItem::initWithLine_incidents(
        line, NSArray::arrayOf({DebugTransitIncident::__debug_fakeIncidentAffectingLine(line)}));
}

std::shared_ptr<OWTransitListItem>
listOf(const std::vector<std::shared_ptr<DebugTransitLineItem>>& lines) {
    return OWTransitIncidentsDataSourceBuilder::
        initWithLineItems_maxNumberOfItems_artworkCache_analytics(
               NSArray::arrayOf(lines), 0, nullptr, nullptr)
            ->listItem();
}

TEST(DebugLineRows, DebugLineItemIsTheSourceOfThePayload) {
    const auto debug = debugLine(7);
    const auto row = std::dynamic_pointer_cast<OWTransitItem>(listOf({debug})->summaryItem());
    ASSERT_TRUE(row);
    EXPECT_EQ(row->primaryText(), "Something Bad™");
    const auto opened = std::dynamic_pointer_cast<OWUserActivityData>(row->openable());
    ASSERT_TRUE(opened);
    const auto compressed =
        std::dynamic_pointer_cast<NSData>(opened->userInfo()->objectForKey("bs"));
    const auto activity = protoMessageWithBytes<OrvoActivity>(
        NSDataOrvoExtra::bzip2UncompressedData(*compressed)->bytes());
    ASSERT_TRUE(activity);
    const auto& stored = activity->lineItem();
    EXPECT_TRUE(equal(stored, TransitStorageLineItem::initWithLineItem(debug)));
    EXPECT_EQ(stored->muid(), 7U);
    EXPECT_EQ(stored->name(), "U7");
    const auto incidents = typed<TransitIncident>(stored->incidents());
    ASSERT_EQ(incidents.size(), 1U);
    EXPECT_EQ(incidents[0]->muid(), 8U);
    EXPECT_EQ(incidents[0]->summary(), "U7 · Possible delays due to strike");
}

TEST(DebugLineRows, MadeUpIncidentsAreStoredInTheListOfAll) {
    const auto classes =
        CodingClassTable::current().overrideWith(std::make_shared<const CodingClassTable>(
            CodingClassTable{CodingClass::of<TransitStorageIncident>("TransitStorageIncident")}));
    const auto summary = std::dynamic_pointer_cast<OWTransitSummaryItem>(
        listOf({debugLine(7), debugLine(20)})->summaryItem());
    ASSERT_TRUE(summary && summary->userActivityData());
    const auto unarchiver = NSKeyedUnarchiver::initForReadingFromData_error(
        std::dynamic_pointer_cast<NSData>(
            summary->userActivityData()->userInfo()->objectForKey("incidentListKey")),
        nullptr);
    ASSERT_TRUE(unarchiver);
    const auto stored = typed<TransitStorageIncident>(std::dynamic_pointer_cast<NSArray>(
        unarchiver->decodeObjectOfClasses_forKey({"NSArray", "TransitStorageIncident"}, "root")));
    ASSERT_EQ(stored.size(), 2U);
    EXPECT_EQ(stored[0]->muid(), 8U);
    EXPECT_EQ(stored[1]->muid(), 21U);
    EXPECT_TRUE(stored[1]->isBlockingIncident());
}

} // namespace
} // namespace orvo
