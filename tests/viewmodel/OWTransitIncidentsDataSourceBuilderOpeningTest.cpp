#include "viewmodel/BuilderTest.h"
#include "viewmodel/OWTransitIncidentsDataSourceBuilder.h"

#include <algorithm>

namespace orvo {
namespace {

using testing::artwork;
using testing::BuilderTest;
using testing::incident;
using testing::line;
using testing::rows;

TEST_F(BuilderTest, LineActivityHoldsTheLineAndMapTypeThreeOnly) {
    const auto activity = payload(summaryRow(world.list({line(7, {incident(70)})})));
    ASSERT_TRUE(activity);
    EXPECT_EQ(activity->lineItem()->muid(), 7U);
    EXPECT_EQ(activity->lineItem()->incidents()->count(), 1U);
    EXPECT_EQ(activity->displayOptions()->mapType(), 3);
    EXPECT_EQ(activity->dictionaryRepresentation()->count(), 2U);
}

TEST_F(BuilderTest, RestoredLineItemIsTheSourceOfThePayload) {
    const auto stored = TransitStorageLineItem::initWithLineItem(
        line(7,
             {incident(70), incident(71)},
             {.name = "U7", .system = testing::system("S", "S"), .alternate = artwork("U7")}));
    const auto restored = protoMessageWithBytes<TransitStorageLineItem>(stored->data()->bytes());
    ASSERT_TRUE(restored);
    const auto list = world.list({restored});
    ASSERT_EQ(rows(list).size(), 2U);
    for (const auto& row : rows(list)) {
        EXPECT_TRUE(equal(sized(row)->artwork(), artwork("U7")));
        EXPECT_TRUE(equal(payload(row)->lineItem(), stored));
    }
    EXPECT_EQ(muidsOfList(summary(list)->userActivityData()), (std::vector<std::uint64_t>{70, 71}));
}

TEST_F(BuilderTest, WhatTheRowsOfALineHandOverIsPackedOnce) {
    int packed = 0;
    const auto scope = Bzip2Compressor().overrideWith(
        [&](const std::uint8_t*, std::size_t, std::uint8_t**, std::size_t*) {
            ++packed;
            return false;
        });
    const auto list = world.list({line(1, {incident(11), incident(12), incident(13)}),
                                  line(2, {incident(21), incident(22)})});
    EXPECT_EQ(rows(list).size(), 5U);
    EXPECT_EQ(packed, 2);
}

TEST_F(BuilderTest, FailedCompressionLeavesTheRowWithoutAnOpenable) {
    const auto scope = Bzip2Compressor().overrideWith(
        [](const std::uint8_t*, std::size_t, std::uint8_t**, std::size_t*) { return false; });
    const auto row = summaryRow(world.list(lines(1, 0)));
    ASSERT_TRUE(row);
    EXPECT_FALSE(row->openable());
}

TEST_F(BuilderTest, FailedArchivingLeavesTheSummaryWithoutAnActivity) {
    const auto scope = NSKeyedArchiver::archiving().overrideWith(
        [](const auto&, bool requiresSecureCoding, auto*) -> std::shared_ptr<NSData> {
            EXPECT_TRUE(requiresSecureCoding);
            return nullptr;
        });
    EXPECT_FALSE(summary(world.list(lines(2, 0)))->userActivityData());
}

TEST_F(BuilderTest, FavouritesURLNamesTypeTwoAndTheTransitMap) {
    const auto url = OWTransitIncidentsDataSourceBuilder::_urlForFavorites();
    ASSERT_TRUE(url);
    EXPECT_EQ(url->absoluteString().substr(0, 24), "orvo://?favorites=2&t=r&");
}

TEST_F(BuilderTest, BothGoodServiceRowsOpenTheFavourites) {
    for (const auto& row :
         {summaryRow(world.list(lines(0, 1))), rows(world.list(lines(1, 1))).back()}) {
        ASSERT_TRUE(std::dynamic_pointer_cast<NSURLOWOpenable>(row->openable()));
        EXPECT_EQ(descriptionOf(row->openable()).substr(0, 23), "orvo://?favorites=2&t=r");
    }
}

TEST_F(BuilderTest, FavouritesURLSharesTheSessionAndThenConvertsTheBuiltURL) {
    const testing::OpeningDoubles doubles;
    const auto url = OWTransitIncidentsDataSourceBuilder::_urlForFavorites();
    EXPECT_EQ(*doubles.journal,
              (std::vector<std::string>{"session callback=0 share=1 reset=0", "conversion"}));
    EXPECT_EQ(url->absoluteString(), "orvo://?favorites=2&t=r&session=S1");
}

TEST_F(BuilderTest, SessionIsSharedForEachRowAsItIsMade) {
    const testing::OpeningDoubles doubles;
    const auto shared = [&](const std::shared_ptr<OWTransitListItem>&) {
        const auto count = std::ranges::count_if(
            *doubles.journal, [](const auto& entry) { return entry.starts_with("session"); });
        doubles.journal->clear();
        return count;
    };
    EXPECT_EQ(shared(world.list({})), 0); // its URL goes as it stands
    EXPECT_EQ(shared(world.list(lines(0, 2))), 1);
    EXPECT_EQ(shared(world.list(lines(1, 0))), 1);
    EXPECT_EQ(shared(world.list(lines(1, 1))), 2);
    EXPECT_EQ(shared(world.list(lines(3, 1))), 5); // three rows, the summary, the clear row
    EXPECT_EQ(shared(world.list(lines(3, 1), 2)),
              6); // and the overflow row; hidden ones are made too
}

TEST_F(BuilderTest, FavouritesURLIsConvertedWhenBuiltAndAgainWhenOpened) {
    const testing::OpeningDoubles doubles;
    const auto row = summaryRow(world.list(lines(0, 1)));
    EXPECT_EQ(std::ranges::count(*doubles.journal, "conversion"), 1);
    row->openable()->openInContext_completionHandler(doubles.controller, {});
    EXPECT_EQ(std::ranges::count(*doubles.journal, "conversion"), 2);
    EXPECT_EQ(doubles.journal->back(), "open orvo://?favorites=2&t=r&session=S1");
}

} // namespace
} // namespace orvo
