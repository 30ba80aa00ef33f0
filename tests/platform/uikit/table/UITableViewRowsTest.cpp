#include "TableTest.h"
#include "platform/foundation/Exceptions.h"

#include <algorithm>

namespace orvo {
namespace {

using TableRowsTest = testing::TableTest;
using Strings = std::vector<std::string>;

const std::string TwoLines = "one two three four five six seven";

TEST_F(TableRowsTest, RowsStandUnderOneAnotherAsHighAsTheirTextsNeed) {
    source->sections = {{"one", TwoLines, "three"}};
    EXPECT_EQ(shown(), R"(
table 100 50 from 0 of 40
  0-0 TextCell 0 10 line
  0-1 TextCell 10 20 line
  0-2 TextCell 30 10 line
)");
}

TEST_F(TableRowsTest, EmptySourceShowsNothing) {
    EXPECT_EQ(shown(), "\ntable 100 50 from 0 of 0\n");
    EXPECT_EQ(table->numberOfSections(), 0);
    EXPECT_EQ(table->indexPathForRowAtPoint({5, 5}), nullptr);
    EXPECT_FALSE(table->pressKey(UITableViewKey::Down));
}

TEST_F(TableRowsTest, SourceWithoutAnAnswerHasOneSection) {
    class Plain final : public UITableViewDataSource {
    public:
        std::int64_t tableView_numberOfRowsInSection(const std::shared_ptr<UITableView>&,
                                                     std::int64_t) override {
            return 1;
        }
        std::shared_ptr<UITableViewCell>
        tableView_cellForRowAtIndexPath(const std::shared_ptr<UITableView>&,
                                        const std::shared_ptr<NSIndexPath>&) override {
            return UITableViewCell::initWithStyle_reuseIdentifier(UITableViewCellStyle::Default,
                                                                  "UITableViewCell");
        }
    };
    const auto plain = std::make_shared<Plain>();
    table->setDataSource(plain);
    table->setDelegate(nullptr);
    EXPECT_EQ(shown(), R"(
table 100 50 from 0 of 44
  0-0 UITableViewCell 0 44 line
)");
}

TEST_F(TableRowsTest, SectionsFollowOneAnother) {
    source->sections = {{"a"}, {}, {"b", "c"}};
    EXPECT_EQ(shown(), R"(
table 100 50 from 0 of 30
  0-0 TextCell 0 10 line
  2-0 TextCell 10 10 line
  2-1 TextCell 20 10 line
)");
    EXPECT_EQ(table->numberOfSections(), 3);
    EXPECT_EQ(table->numberOfRowsInSection(1), 0);
    EXPECT_EQ(table->numberOfRowsInSection(2), 2);
    EXPECT_EQ(table->numberOfRowsInSection(3), 0);
    EXPECT_EQ(table->numberOfRowsInSection(-1), 0);
    EXPECT_EQ(table->rectForRowAtIndexPath(*path(1, 2)), (CGRect{{0, 20}, {100, 10}}));
    EXPECT_EQ(table->rectForRowAtIndexPath(*path(0, 1)), CGRect());
    EXPECT_TRUE(equal(table->indexPathForRowAtPoint({50, 15}), path(0, 2)));
    EXPECT_EQ(table->indexPathForRowAtPoint({50, 30}), nullptr);
    EXPECT_EQ(table->indexPathForRowAtPoint({100, 15}), nullptr);
}

TEST_F(TableRowsTest, OnlyRowsInSightAreAskedForEvenWhereTheEstimateIsFarTooLow) {
    source->sections = {rows(1000)};
    source->estimate = 1;
    shown();
    EXPECT_EQ(source->asked, (Strings{"cell 0-0", "cell 0-1", "cell 0-2", "cell 0-3", "cell 0-4"}));
    EXPECT_EQ(made, 5);
    EXPECT_EQ(table->contentSize().height, 5 * 10 + 995 * 1);
}

TEST_F(TableRowsTest, RowsWithoutAnEstimateCountAs44UntilTheyAreSeen) {
    source->sections = {rows(10)};
    shown();
    EXPECT_EQ(table->contentSize().height, 5 * 10 + 5 * 44);
}

TEST_F(TableRowsTest, GivenHeightsAreNotMeasured) {
    source->sections = {rows(3)};
    source->heights = {{1, 25}};
    table->setRowHeight(12);
    EXPECT_EQ(shown(), R"(
table 100 50 from 0 of 49
  0-0 TextCell 0 12 line
  0-1 TextCell 12 25 line
  0-2 TextCell 37 12 line
)");
    source->heights = {{1, UITableViewAutomaticDimension}};
    table->reloadData();
    EXPECT_EQ(shown(), R"(
table 100 50 from 0 of 34
  0-0 TextCell 0 12 line
  0-1 TextCell 12 10 line
  0-2 TextCell 22 12 line
)");
}

TEST_F(TableRowsTest, CellThatSaysHowHighItIsIsThatHighWhateverTheEstimate) {
    source->sections = {rows(1)};
    source->estimate = 5;
    shown();
    const auto cell = std::dynamic_pointer_cast<testing::TextCell>(table->visibleCells().at(0));
    cell->contentView()->heightAnchor().constraintEqualToConstant(33)->setActive(true);
    cell->bottom->setActive(false);
    table->reloadData();
    EXPECT_EQ(shown(), R"(
table 100 50 from 0 of 33
  0-0 TextCell 0 33 line
)");
    EXPECT_TRUE(log.messages().empty());
}

TEST_F(TableRowsTest, WheelBringsFurtherRowsAndHandsThemTheCellsThatWentOut) {
    source->sections = {rows(1000)};
    shown();
    source->asked.clear();
    EXPECT_TRUE(table->scrollBy({0, 20}));
    EXPECT_EQ(texts(), (Strings{"row 2", "row 3", "row 4", "row 5", "row 6"}));
    EXPECT_EQ(source->asked, (Strings{"cell 0-5", "cell 0-6"}));
    EXPECT_EQ(made, 5);
    for (int i = 0; i < 200; ++i)
        table->scrollBy({0, 7});
    texts();
    EXPECT_LE(made, 7);
    const auto reuses = dynamic_cast<testing::TextCell&>(*table->visibleCells().at(0)).reuses;
    EXPECT_GT(reuses, 10);
}

TEST_F(TableRowsTest, SubviewsStandInTheOrderOfTheRows) {
    source->sections = {rows(30)};
    shown();
    for (const double step : {20.0, 33.0, -41.0}) {
        table->scrollBy({0, step});
        card->layoutIfNeeded();
        const auto cells = table->visibleCells();
        auto expected = std::vector<std::shared_ptr<UIView>>(cells.begin(), cells.end());
        expected.push_back(table->tableFooterView());
        EXPECT_EQ(table->subviews(), expected);
    }
}

TEST_F(TableRowsTest, ScrollingStopsAtTheLastRowAndSaysSo) {
    source->sections = {rows(10)};
    source->estimate = 3;
    shown();
    EXPECT_TRUE(table->scrollBy({0, 1000}));
    EXPECT_EQ(texts(), (Strings{"row 5", "row 6", "row 7", "row 8", "row 9"}));
    EXPECT_EQ(table->contentOffset().y, 50);
    EXPECT_FALSE(table->scrollBy({0, 1}));
}

TEST_F(TableRowsTest, RowsAboveThatAreMeasuredLateDoNotMoveWhatIsInSight) {
    source->sections = {rows(30)};
    source->estimate = 3;
    table->scrollToRowAtIndexPath(*path(29));
    source->sections = {std::vector<std::string>(30, TwoLines)};
    table->reloadData();
    table->scrollToRowAtIndexPath(*path(29));
    for (int i = 0; i < 80; ++i) {
        const auto watched = table->visibleCells().front();
        const auto before = watched->convertPoint_toView({0, 0}, *card).y;
        table->scrollBy({0, -9});
        card->layoutIfNeeded();
        if (table->contentOffset().y > 0) {
            ASSERT_EQ(watched->convertPoint_toView({0, 0}, *card).y, before + 9);
        }
    }
    EXPECT_EQ(table->contentOffset().y, 0);
    EXPECT_EQ(table->contentSize().height, 30 * 20);
}

TEST_F(TableRowsTest, ReloadGivesEachRowItsOwnCellAgain) {
    source->sections = {rows(4)};
    shown();
    const auto before = table->visibleCells();
    source->sections[0][2] = "another";
    table->reloadData();
    EXPECT_EQ(texts(), (Strings{"row 0", "row 1", "another", "row 3"}));
    EXPECT_EQ(table->visibleCells(), before);
}

TEST_F(TableRowsTest, ReloadGivesEachRowItsOwnCellAlsoWhereOthersAreFree) {
    source->sections = {rows(30)};
    shown();
    table->scrollBy({0, 25}); // a sixth row is partly in sight
    table->scrollBy({0, -25});
    shown();
    const auto before = table->visibleCells();
    const auto measured = measurer->measured;
    table->reloadData();
    shown();
    EXPECT_EQ(made, 6);
    EXPECT_EQ(table->visibleCells(), before);
    EXPECT_EQ(measurer->measured, measured);
}

TEST_F(TableRowsTest, ReloadKeepsThePlaceThatWasScrolledTo) {
    source->sections = {rows(30)};
    source->estimate = 3;
    table->scrollToRowAtIndexPath(*path(20));
    const auto offset = table->contentOffset().y;
    table->reloadData();
    shown();
    EXPECT_EQ(table->contentOffset().y, offset);
}

TEST_F(TableRowsTest, FewerRowsPullTheOffsetBack) {
    source->sections = {rows(30)};
    table->scrollToRowAtIndexPath(*path(29));
    source->sections = {rows(6)};
    table->reloadData();
    EXPECT_EQ(texts(), (Strings{"row 1", "row 2", "row 3", "row 4", "row 5"}));
}

TEST_F(TableRowsTest, AnotherWidthMeasuresAgain) {
    source->sections = {{TwoLines}};
    shown();
    table->setFrame({{0, 0}, {200, 50}});
    EXPECT_EQ(shown(), R"(
table 200 50 from 0 of 10
  0-0 TextCell 0 10 line
)");
}

TEST_F(TableRowsTest, SectionIsReloadedWithoutTouchingTheOthers) {
    source->sections = {{"a"}, {"b", "c"}, {"d"}};
    shown();
    source->asked.clear();
    source->sections[1] = {"x"};
    table->reloadSections_withRowAnimation({1}, UITableViewRowAnimation::None);
    EXPECT_EQ(texts(), (Strings{"a", "x", "d"}));
    EXPECT_EQ(source->asked, (Strings{"cell 1-0"}));
}

TEST_F(TableRowsTest, SectionThatIsNoneCannotBeReloaded) {
    source->sections = {{"a"}};
    shown();
    EXPECT_THROW(table->reloadSections_withRowAnimation({1}, UITableViewRowAnimation::None),
                 NSInvalidArgumentException);
    EXPECT_EQ(texts(), (Strings{"a"}));
}

TEST_F(TableRowsTest, RowsWhereThereWereNoneFadeInWhenReloadedWithAnimation) {
    withFrames();
    source->sections = {rows(1)};
    shown();
    source->sections = {rows(3)};
    table->reloadSections_withRowAnimation({0}, UITableViewRowAnimation::Automatic);
    card->layoutIfNeeded();
    const auto alphas = [this] {
        std::vector<double> all;
        for (const auto& cell : table->visibleCells())
            all.push_back(cell->alpha());
        return all;
    };
    EXPECT_EQ(alphas(), (std::vector<double>{1, 0, 0}));
    advance(0.13 + 0.06);
    EXPECT_EQ(alphas().at(0), 1);
    EXPECT_NEAR(alphas().at(1), 0.5, 1e-9);
    advance(0.06);
    EXPECT_EQ(alphas(), (std::vector<double>{1, 1, 1}));
}

TEST_F(TableRowsTest, CellThatIsNeededElsewhereStopsFading) {
    withFrames();
    source->sections = {rows(1)};
    shown();
    source->sections = {rows(3)};
    table->reloadSections_withRowAnimation({0}, UITableViewRowAnimation::Automatic);
    card->layoutIfNeeded();
    table->reloadSections_withRowAnimation({0}, UITableViewRowAnimation::Automatic);
    card->layoutIfNeeded();
    advance(0.2);
    for (const auto& cell : table->visibleCells())
        EXPECT_EQ(cell->alpha(), 1);
}

TEST_F(TableRowsTest, NothingFadesWithoutAnimationOrForWhoWantsLessMotion) {
    withFrames();
    source->sections = {rows(1)};
    shown();
    source->sections = {rows(2)};
    table->reloadSections_withRowAnimation({0}, UITableViewRowAnimation::None);
    card->layoutIfNeeded();
    EXPECT_EQ(table->visibleCells().at(1)->alpha(), 1);
    card->setTraitCollection(UITraitCollection{.reducesMotion = true});
    source->sections = {rows(3)};
    table->reloadSections_withRowAnimation({0}, UITableViewRowAnimation::Automatic);
    card->layoutIfNeeded();
    EXPECT_EQ(table->visibleCells().at(2)->alpha(), 1);
}

TEST_F(TableRowsTest, RowsThatComeIntoSightLaterDoNotFade) {
    withFrames();
    source->sections = {rows(1)};
    shown();
    source->sections = {rows(30)};
    table->reloadSections_withRowAnimation({0}, UITableViewRowAnimation::Automatic);
    card->layoutIfNeeded();
    table->scrollToRowAtIndexPath(*path(29));
    for (const auto& cell : table->visibleCells())
        EXPECT_EQ(cell->alpha(), 1);
}

TEST_F(TableRowsTest, CellsThatWereFreeWhenTheTraitsChangedAreNotUsedAgain) {
    source->sections = {rows(3)};
    shown();
    source->sections = {rows(1)};
    table->reloadData();
    shown();
    card->setTraitCollection(
        UITraitCollection{.layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft});
    source->sections = {rows(3)};
    table->reloadData();
    shown();
    EXPECT_EQ(made, 5);
}

TEST_F(TableRowsTest, UnchangedTableCostsNothing) {
    source->sections = {rows(4)};
    draw();
    source->asked.clear();
    const auto measured = measurer->measured;
    card->layoutIfNeeded();
    EXPECT_FALSE(card->_needsDisplay());
    draw();
    card->setNeedsLayout();
    table->setNeedsLayout();
    draw();
    EXPECT_TRUE(source->asked.empty());
    EXPECT_EQ(measurer->measured, measured);
}

TEST_F(TableRowsTest, ReloadOfTheSameTextsMeasuresNoText) {
    source->sections = {rows(4)};
    draw();
    const auto measured = measurer->measured;
    const auto labels = UILabel::_measurements();
    table->reloadData();
    draw();
    EXPECT_EQ(measurer->measured, measured);
    EXPECT_EQ(UILabel::_measurements(), labels);
}

TEST_F(TableRowsTest, IdentifierWithoutAClassIsAnError) {
    EXPECT_EQ(table->dequeueReusableCellWithIdentifier("none"), nullptr);
    EXPECT_THROW(std::ignore =
                     table->dequeueReusableCellWithIdentifier_forIndexPath("none", path(0)),
                 NSInvalidArgumentException);
    table->registerClass_forCellReuseIdentifier(nullptr, "text");
    EXPECT_EQ(table->dequeueReusableCellWithIdentifier("text"), nullptr);
}

TEST_F(TableRowsTest, SourceThatGoesLeavesAnEmptyTable) {
    source->sections = {rows(100)};
    shown();
    source.reset();
    table->scrollBy({0, 30});
    EXPECT_EQ(shown(), "\ntable 100 50 from 0 of 0\n");
}

TEST_F(TableRowsTest, SourceMayReloadTheTableWhileItIsAsked) {
    class Restless final : public UITableViewDataSource {
    public:
        std::int64_t rows = 3;
        std::int64_t tableView_numberOfRowsInSection(const std::shared_ptr<UITableView>&,
                                                     std::int64_t) override {
            return rows;
        }
        std::shared_ptr<UITableViewCell>
        tableView_cellForRowAtIndexPath(const std::shared_ptr<UITableView>& table,
                                        const std::shared_ptr<NSIndexPath>& path) override {
            if (rows == 3 && path->row() == 1) {
                rows = 1;
                table->reloadData();
            }
            return table->dequeueReusableCellWithIdentifier_forIndexPath("text", path);
        }
    };
    const auto restless = std::make_shared<Restless>();
    table->setDelegate(nullptr);
    table->setDataSource(restless);
    shown();
    EXPECT_EQ(table->visibleCells().size(), 1U);
    EXPECT_EQ(table->subviews().size(), 2U);
}

TEST_F(TableRowsTest, HeightsAreWholeDevicePixels) {
    card->setTraitCollection(UITraitCollection{.displayScale = 2});
    source->sections = {rows(2)};
    source->heights = {{0, 10.3}};
    EXPECT_EQ(shown(), R"(
table 100 50 from 0 of 20.5
  0-0 TextCell 0 10.5 line
  0-1 TextCell 10.5 10 line
)");
}

} // namespace
} // namespace orvo
