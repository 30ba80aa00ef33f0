#include "presentation/OWTransitIncidentDataSource.h"
#include "presentation/OWTransitItemFixedHeightCell.h"
#include "presentation/OWTransitSummaryCell.h"
#include "viewmodel/BuilderWorld.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>
#include <utility>
#include <vector>

// In which order the table, its cells and the delegate are told things, in one list for all.

namespace orvo {
namespace {

using testing::artwork;
using testing::BuilderWorld;
using ::testing::ElementsAre;
using testing::incident;
using testing::line;

using Calls = std::vector<std::string>;

/// Writes down what it is told, and is otherwise a row.
class ToldItemCell final : public OWTransitItemFixedHeightCell {
public:
    ToldItemCell(Calls& calls, const std::string& identifier)
        : _calls(calls)
        , _identifier(identifier) {}
    bool initialise() {
        return _initWithStyle_reuseIdentifier(UITableViewCellStyle::Default, _identifier);
    }
    void setTransitItem(const std::shared_ptr<OWTransitItem>& item) override {
        _calls.push_back("item " + item->secondaryText().value_or("(nil)"));
        OWTransitItemFixedHeightCell::setTransitItem(item);
    }
    void setTrailingArtworkColumnWidth(double width) override {
        _calls.push_back("column " + std::to_string(std::lround(width)));
        OWTransitItemFixedHeightCell::setTrailingArtworkColumnWidth(width);
    }
    void setRowHeight(double height) override {
        _calls.push_back("height " + std::to_string(std::lround(height)));
        OWTransitItemFixedHeightCell::setRowHeight(height);
    }
    void setSeparatorStyleOverride(std::optional<UITableViewCellSeparatorStyle> style) override {
        _calls.push_back("separator " + std::to_string(static_cast<int>(style.value())));
        OWTransitItemFixedHeightCell::setSeparatorStyleOverride(style);
    }

private:
    Calls& _calls;
    std::string _identifier;
};

class ToldSummaryCell final : public OWTransitSummaryCell {
public:
    ToldSummaryCell(Calls& calls, const std::string& identifier)
        : _calls(calls)
        , _identifier(identifier) {}
    bool initialise() {
        return _initWithStyle_reuseIdentifier(UITableViewCellStyle::Default, _identifier);
    }
    void setArtworkCache(const std::shared_ptr<ArtworkDataSourceCache>& cache) override {
        _calls.emplace_back("cache");
        OWTransitSummaryCell::setArtworkCache(cache);
    }
    void setItem(const std::shared_ptr<OWTransitSummaryItem>& item) override {
        _calls.push_back("item of " + std::to_string(item->artworks()->count()));
        OWTransitSummaryCell::setItem(item);
    }
    void setRowHeight(double height) override {
        _calls.push_back("height " + std::to_string(std::lround(height)));
        OWTransitSummaryCell::setRowHeight(height);
    }
    void setSeparatorStyleOverride(std::optional<UITableViewCellSeparatorStyle> style) override {
        _calls.push_back("separator " + std::to_string(static_cast<int>(style.value())));
        OWTransitSummaryCell::setSeparatorStyleOverride(style);
    }

private:
    Calls& _calls;
    std::string _identifier;
};

/// Makes recording cells in place of those that are registered, and writes down what it is told.
class ToldTable final : public UITableView {
public:
    explicit ToldTable(Calls& calls)
        : _calls(calls) {}
    static std::shared_ptr<ToldTable> make(Calls& calls) {
        auto table = std::make_shared<ToldTable>(calls);
        table->_initWithFrame_style({{0, 0}, {359, 1000}}, UITableViewStyle::Plain);
        return table;
    }
    void registerClass_forCellReuseIdentifier(CellClass, const std::string& identifier) override {
        UITableView::registerClass_forCellReuseIdentifier(
            [this, identifier](UITableViewCellStyle, const std::optional<std::string>&) {
                return identifier == "OWTransitSummaryCell" ? made<ToldSummaryCell>(identifier)
                                                            : made<ToldItemCell>(identifier);
            },
            identifier);
    }
    std::shared_ptr<UITableViewCell> dequeueReusableCellWithIdentifier_forIndexPath(
        const std::string& identifier, const std::shared_ptr<NSIndexPath>& indexPath) override {
        _calls.push_back("dequeue " + identifier);
        return UITableView::dequeueReusableCellWithIdentifier_forIndexPath(identifier, indexPath);
    }
    void deselectRowAtIndexPath_animated(const std::shared_ptr<NSIndexPath>& indexPath,
                                         bool animated) override {
        _calls.emplace_back(animated ? "deselect animated" : "deselect");
        UITableView::deselectRowAtIndexPath_animated(indexPath, animated);
    }

private:
    template <class Cell>
    std::shared_ptr<UITableViewCell> made(const std::string& identifier) {
        auto cell = std::make_shared<Cell>(_calls, identifier);
        EXPECT_TRUE(cell->initialise());
        return cell;
    }
    Calls& _calls;
};

/// Writes down what it hears, and what the source has at that moment.
class ToldDelegate final : public OWTransitIncidentDataSourceDelegate {
public:
    explicit ToldDelegate(Calls& calls)
        : _calls(calls) {}
    void dataSource_didSelectOpenableItem_atIndexPath(
        const std::shared_ptr<OWTransitIncidentDataSource>&,
        const std::shared_ptr<OWOpenable>&,
        const std::shared_ptr<NSIndexPath>& indexPath) override {
        _calls.push_back("select " + std::to_string(indexPath->row()));
    }
    void dataSourceDidUpdateContent(
        const std::shared_ptr<OWTransitIncidentDataSource>& source) override {
        const auto& fitted = source->shieldAdjustedExpandedItems();
        const bool isRefitted = source->shieldAjustedSummaryItem() && fitted &&
                                fitted->count() == source->listItem()->expandedItems()->count();
        _calls.emplace_back(isRefitted ? "content, refitted" : "content, not refitted");
    }

private:
    Calls& _calls;
};

class DataSourceCellsTest : public ::testing::Test {
protected:
    /// Two lines with an advisory each.
    std::shared_ptr<OWTransitIncidentDataSource> make(bool expanded) {
        return make(expanded,
                    {line(1, {incident(11)}, {.name = "U1", .alternate = artwork("a")}),
                     line(2, {incident(12)}, {.name = "U2", .alternate = artwork("b")})});
    }
    std::shared_ptr<OWTransitIncidentDataSource>
    make(bool expanded, const std::vector<std::shared_ptr<TransitLineItem>>& lines) {
        auto source = OWTransitIncidentDataSource::
            initWithTransitLineItemsResult_expanded_artworkCache_maxNumberOfRows_availableWidth(
                Result::resultWithValue(NSArray::arrayOf(lines)),
                expanded,
                world.cache,
                std::numeric_limits<std::uint64_t>::max(),
                359);
        source->setDelegate(delegate);
        source->configureTableView(table);
        calls.clear();
        return source;
    }
    static std::shared_ptr<NSIndexPath> row(std::int64_t number) {
        return NSIndexPath::indexPathForRow_inSection(number, 0);
    }

    Calls calls;
    BuilderWorld world;
    std::shared_ptr<ToldTable> table = ToldTable::make(calls);
    std::shared_ptr<ToldDelegate> delegate = std::make_shared<ToldDelegate>(calls);
};

TEST_F(DataSourceCellsTest, ARowsCellIsGivenItsItemThenTheColumnThenTheHeight) {
    const auto source = make(true);
    (void)source->tableView_cellForRowAtIndexPath(table, row(0));
    EXPECT_THAT(calls,
                ElementsAre("dequeue OWTransitItemFixedHeightCell",
                            "item Summary",
                            "column 73",
                            "height 110",
                            "separator 1"));
    calls.clear();
    (void)source->tableView_cellForRowAtIndexPath(table, row(1));
    EXPECT_EQ(calls.back(), "separator 0");
}

TEST_F(DataSourceCellsTest, TheSummarysCellIsGivenTheCacheThenItsItemThenTheHeight) {
    const auto source = make(false);
    (void)source->tableView_cellForRowAtIndexPath(table, row(0));
    EXPECT_THAT(
        calls,
        ElementsAre(
            "dequeue OWTransitSummaryCell", "cache", "item of 2", "height 110", "separator 0"));
}

TEST_F(DataSourceCellsTest, WhatIsNoRowIsNotDequeued) {
    const auto source = make(true);
    (void)source->tableView_cellForRowAtIndexPath(table, row(2));
    EXPECT_THAT(calls, ElementsAre());
}

TEST_F(DataSourceCellsTest, ATapIsDeselectedBeforeItIsTold) {
    const auto source = make(true);
    source->tableView_didSelectRowAtIndexPath(table, row(1));
    EXPECT_THAT(calls, ElementsAre("deselect animated", "select 1"));
}

TEST_F(DataSourceCellsTest, TheDelegateHearsOfAListWhenItsRowsAreFitted) {
    const auto source = make(true);
    source->updateTransitLineItemResult_captureAnalytics(
        Result::resultWithValue(NSArray::arrayOf(std::vector{
            line(3, {incident(13)}), line(4, {incident(14)}), line(5, {incident(15)})})),
        nullptr);
    EXPECT_THAT(calls, ElementsAre("content, refitted"));
    EXPECT_EQ(source->tableView_numberOfRowsInSection(table, 0), 3);
}

TEST_F(DataSourceCellsTest, LinesThatShareAShieldHaveOneInTheSummary) {
    const auto source = make(false,
                             {line(1, {incident(11)}, {.name = "U1", .alternate = artwork("a")}),
                              line(2, {incident(12)}, {.name = "U2", .alternate = artwork("a")}),
                              line(3, {incident(13)}, {.name = "U3", .alternate = artwork("b")})});
    const auto summary =
        std::dynamic_pointer_cast<OWTransitSummaryItem>(source->shieldAjustedSummaryItem());
    ASSERT_TRUE(summary);
    EXPECT_EQ(summary->artworks()->count(), 2U);
}

} // namespace
} // namespace orvo
