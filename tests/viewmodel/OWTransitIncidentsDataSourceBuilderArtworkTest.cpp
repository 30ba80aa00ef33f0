#include "viewmodel/BuilderTest.h"
#include "viewmodel/OWTransitIncidentsDataSourceBuilder.h"

namespace orvo {
namespace {

using testing::artwork;
using testing::BuilderTest;
using testing::incident;
using testing::line;
using testing::rows;

TEST_F(BuilderTest, RowShowsTheAlternateArtworkElseTheSystemsNeverTheLinesOwn) {
    const auto own = summaryRow(world.list({line(
        1, {incident(1)}, {.system = testing::system("S", "S"), .alternate = artwork("U1")})}));
    EXPECT_TRUE(equal(sized(own)->artwork(), artwork("U1")));
    const auto systems =
        summaryRow(world.list({line(1, {incident(1)}, {.system = testing::system("S", "S")})}));
    EXPECT_TRUE(equal(sized(systems)->artwork(), artwork("S")));
    const auto none = summaryRow(world.list({line(1, {incident(1)})}));
    ASSERT_TRUE(sized(none)); // still an artwork, of nothing
    EXPECT_FALSE(sized(none)->artwork());
    EXPECT_EQ(sized(own)->shieldSize(), 7);
    EXPECT_EQ(sized(own)->artworkCache(), world.cache);
    EXPECT_EQ(own->artwork()->alpha(), 1.0);
    EXPECT_FALSE(own->isArtworkHidden());
}

class SharedRowTest : public BuilderTest {
protected:
    /// The row of one incident that lines of these systems share, each line with a shield of its
    /// own.
    std::shared_ptr<OWTransitItem> sharedRow(const std::vector<const char*>& marks) {
        Lines all;
        for (std::size_t i = 0; i < marks.size(); ++i)
            all.push_back(line(i + 1,
                               {incident(10)},
                               {.name = i == 0 ? "first" : "other",
                                .system = testing::system("S", marks[i]),
                                .alternate = artwork("own")}));
        return rows(world.list(all))[0];
    }
};

TEST_F(SharedRowTest, ShowsTheSystemsArtworkWhenAllAgree) {
    const auto row = sharedRow({"A", "A", "A"});
    EXPECT_TRUE(equal(sized(row)->artwork(), artwork("A")));
    EXPECT_EQ(sized(row)->shieldSize(), 7);
    EXPECT_EQ(row->artwork()->alpha(), 1.0);
    EXPECT_EQ(row->primaryText(), "Title");
    EXPECT_EQ(payload(row)->lineItem()->muid(), 1U); // what a tap opens stays the first line's
}

TEST_F(SharedRowTest, PassesOverLinesBeforeTheFirstThatHasOne) {
    EXPECT_TRUE(equal(sized(sharedRow({nullptr, "A", "A"}))->artwork(), artwork("A")));
}

TEST_F(SharedRowTest, IsGenericWhenALaterOneIsMissingOrDiffersOrNoneHasOne) {
    for (const auto& marks : {std::vector<const char*>{"A", nullptr},
                              std::vector<const char*>{"A", "B"},
                              std::vector<const char*>{nullptr, nullptr},
                              std::vector<const char*>{nullptr, "A", nullptr}}) {
        const auto row = sharedRow(marks);
        EXPECT_EQ(imageName(row), "WidgetGenericTransit");
        EXPECT_EQ(row->artwork()->alpha(), 0.30000001192092896);
        EXPECT_NE(row->artwork()->alpha(), 0.3);
    }
}

TEST_F(SharedRowTest, OnlyRowsOfSeveralLinesAreRewrittenAndKeepWhatIsNotTheirs) {
    const auto openable = NSURLOWOpenable::openableWithURL(NSURL::URLWithString("orvo://?t=r"));
    const auto row = [&] {
        return OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
            "Title", "Summary", nullptr, true, openable);
    };
    std::vector<_OWDisplayedRow> displayed{{row(), {line(1, {})}},
                                           {row(), {line(2, {}), line(3, {})}}};
    const auto alone = displayed[0].item;
    const auto shared = displayed[1].item;
    world.builder({})->_updateItemsAffectingSeveralLines_itemToLinesMap(displayed);
    EXPECT_EQ(displayed[0].item, alone);
    ASSERT_NE(displayed[1].item, shared);
    EXPECT_EQ(displayed[1].item->primaryText(), "Title");
    EXPECT_TRUE(displayed[1].item->isArtworkHidden());
    EXPECT_EQ(displayed[1].item->openable(), openable);
    EXPECT_EQ(displayed[1].lines.size(), 2U);
}

TEST_F(BuilderTest, SummaryShowsDistinctShieldsInRowOrderSharedRowsTheLinesOwn) {
    const auto system = testing::system("S", "S");
    const auto list = world.list(
        {line(1, {incident(10)}, {.system = system, .alternate = artwork("U1")}),
         line(2, {incident(20)}, {.system = system}),
         line(3, {incident(10), incident(30)}, {.system = system, .alternate = artwork("U3")}),
         line(4, {incident(40)}),
         line(5, {incident(50)}, {.alternate = artwork("U1")})});
    const auto artworks = typed<TransitArtworkDataSource>(summary(list)->artworks());
    ASSERT_EQ(artworks.size(), 3U);
    EXPECT_TRUE(equal(artworks[0], artwork("U1")));
    EXPECT_TRUE(equal(artworks[1], artwork("U3"))); // row 1 is shown by lines 1 and 3
    EXPECT_TRUE(equal(artworks[2], artwork("S")));
    EXPECT_EQ(summary(list)->primaryText(), "TransitWidget_Summary_advisory_count[5][][]");
}

TEST_F(BuilderTest, ThreeAdvisoriesOfOneSystemWithoutOwnShieldsGiveOneArtwork) {
    const auto system = testing::system("S", "S");
    const auto list = world.list({line(1, {incident(10)}, {.system = system}),
                                  line(2, {incident(20)}, {.system = testing::system("S", "S")}),
                                  line(3, {incident(30)}, {.system = system})});
    EXPECT_EQ(summary(list)->artworks()->count(), 1U);
}

} // namespace
} // namespace orvo
