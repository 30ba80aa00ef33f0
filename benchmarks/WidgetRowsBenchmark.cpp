// The widget's own table, cells and fonts, off screen: one cell made and laid out; all rows at
// another width; the first picture; a way through a thousand rows. Time should be linear in the
// rows that are seen, and the expanded widget laid out anew in less than a millisecond.

#include "../tests/support/GraphicalApplication.h"
#include "platform/geoservices/TransitIncidentRecord.h"
#include "platform/geoservices/TransitLineItemRecord.h"
#include "platform/mapuikit/TransitArtworkManager.h"
#include "platform/uikit/UIColor.h"
#include "platform/uikit/UIImage.h"
#include "platform/uikit/ViewDrawing.h"
#include "presentation/OWTransitIncidentDataSource.h"
#include "presentation/OWTransitItemFixedHeightCell.h"

#include <benchmark/benchmark.h>

#include <cstdlib>
#include <limits>
#include <string>
#include <vector>

namespace {

using namespace orvo;

constexpr CGFloat Width = 327;
constexpr CGFloat RowHeight = 110;
constexpr double Scale = 2;
constexpr std::int64_t RowsInSight = 8;

void useScreen() {
    setenv("QT_QPA_PLATFORM", "offscreen", 0);
    static_cast<void>(orvo::testing::haveGraphicalApplication());
    UITraitCollection::system().set({.displayScale = Scale});
}

/// The one of a table, with a picture each.
std::shared_ptr<ArtworkDataSourceCache> pictures() {
    return ArtworkDataSourceCache::initWithArtworkManager(
        TransitArtworkManager::initWithIconManager(IconManager::sharedManager()));
}

std::shared_ptr<TransitArtworkDataSource> shield(const std::string& text) {
    return TransitArtworkDataSource::initWithFields(
        {.artworkSourceType = 1,
         .shieldDataSource = TransitShieldDataSource::initWithFields(
             {.shieldType = 2, .shieldText = text, .shieldColorString = "1B7F3B,FFFFFF"})});
}

/// As many lines with an incident each.
std::shared_ptr<Result> makeResult(std::int64_t count) {
    std::vector<std::shared_ptr<TransitLineItem>> lines;
    for (std::int64_t i = 0; i < count; ++i) {
        const auto number = static_cast<std::uint64_t>(i + 1);
        const auto incident = TransitIncidentRecord::initWithFields(
            {.muid = number,
             .title = "Trams diverted at Old Harbour, " + std::to_string(number),
             .summary = "Track works: line " + std::to_string(number) +
                        " runs by way of Quay Street, without the stop Old Harbour."});
        lines.push_back(TransitLineItemRecord::initWithFields_service(
            {.muid = number,
             .name = std::to_string(number),
             .alternateArtwork = shield(std::to_string(number % 40))},
            {.incidents = NSArray::arrayOf(std::vector{incident})}));
    }
    return Result::resultWithValue(NSArray::arrayOf(lines));
}

/// The table of the expanded widget, of which `seen` rows are in sight.
struct Table {
    Table(const std::shared_ptr<Result>& result,
          const std::shared_ptr<ArtworkDataSourceCache>& cache,
          std::int64_t seen)
        : source(
              OWTransitIncidentDataSource::
                  initWithTransitLineItemsResult_expanded_artworkCache_maxNumberOfRows_availableWidth(
                      result, true, cache, std::numeric_limits<std::uint64_t>::max(), Width))
        , card(UIView::initWithFrame({{0, 0}, {Width, height(seen)}}))
        , table(UITableView::initWithFrame_style({{0, 0}, {Width, height(seen)}},
                                                 UITableViewStyle::Plain)) {
        card->setBackgroundColor(UIColor::cardColor());
        card->addSubview(table);
        source->configureTableView(table);
    }
    static CGFloat height(std::int64_t rows) { return RowHeight * static_cast<CGFloat>(rows); }
    void setWidth(CGFloat width) const {
        source->setAvailableWidth(width);
        card->setFrame({{0, 0}, {width, card->frame().size.height}});
        table->setFrame({{0, 0}, {width, card->frame().size.height}});
        card->layoutIfNeeded();
    }

    std::shared_ptr<OWTransitIncidentDataSource> source;
    std::shared_ptr<UIView> card;
    std::shared_ptr<UITableView> table;
};

void perRow(benchmark::State& state, std::int64_t rows) {
    state.counters["per_row"] =
        benchmark::Counter(static_cast<double>(state.iterations() * rows),
                           benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}

/// A cell that no row has had yet: its views, constraints, fonts and texts.
void makeCell(benchmark::State& state) {
    useScreen();
    const Table table(makeResult(2), pictures(), 2);
    const auto item = std::dynamic_pointer_cast<OWTransitItem>(
        table.source->shieldAdjustedExpandedItems()->objectAtIndex(0));
    for (auto _ : state) {
        const auto cell = OWTransitItemFixedHeightCell::initWithStyle_reuseIdentifier(
            UITableViewCellStyle::Default, "cell");
        cell->setFrame({{0, 0}, {Width, RowHeight}});
        cell->setTransitItem(item);
        cell->setTrailingArtworkColumnWidth(73);
        cell->layoutIfNeeded();
    }
}

/// A cell that shows one row after the other.
void reuseCell(benchmark::State& state) {
    useScreen();
    const Table table(makeResult(40), pictures(), 2);
    const auto items = typed<OWTransitItem>(table.source->shieldAdjustedExpandedItems());
    const auto cell = OWTransitItemFixedHeightCell::initWithStyle_reuseIdentifier(
        UITableViewCellStyle::Default, "cell");
    cell->setFrame({{0, 0}, {Width, RowHeight}});
    std::size_t next = 0;
    for (auto _ : state) {
        cell->setTransitItem(items[next++ % items.size()]);
        cell->layoutIfNeeded();
    }
}

/// All rows are in sight, and the widget gets wider and narrower.
void layOutAtAnotherWidth(benchmark::State& state) {
    useScreen();
    const Table table(makeResult(state.range(0)), pictures(), state.range(0));
    table.card->layoutIfNeeded();
    CGFloat width = Width;
    for (auto _ : state) {
        width = width > Width ? Width : Width + 20;
        table.setWidth(width);
    }
    perRow(state, state.range(0));
}

/// One constant of each row, by which all that stands in it moves.
void layOutAtAnotherRowHeight(benchmark::State& state) {
    useScreen();
    const Table table(makeResult(state.range(0)), pictures(), state.range(0));
    table.card->layoutIfNeeded();
    CGFloat height = RowHeight;
    for (auto _ : state) {
        height = height < RowHeight ? RowHeight : RowHeight - 1;
        for (const auto& cell : table.table->visibleCells()) {
            std::static_pointer_cast<OWTransitItemFixedHeightCell>(cell)->setRowHeight(height);
            cell->layoutIfNeeded();
        }
    }
    perRow(state, state.range(0));
}

void layOutUnchanged(benchmark::State& state) {
    useScreen();
    const Table table(makeResult(state.range(0)), pictures(), state.range(0));
    table.card->layoutIfNeeded();
    for (auto _ : state) {
        table.table->setNeedsLayout();
        table.card->layoutIfNeeded();
    }
    perRow(state, state.range(0));
}

/// From a fetch's result to pixels, shields drawn for the first time.
void firstPaint(benchmark::State& state) {
    useScreen();
    const auto result = makeResult(state.range(0));
    for (auto _ : state) {
        const Table table(result, pictures(), state.range(0));
        benchmark::DoNotOptimize(snapshotOf(*table.card, Scale));
    }
    perRow(state, state.range(0));
}

/// The same rows again, as after a part of the screen was uncovered.
void paintAgain(benchmark::State& state) {
    useScreen();
    const Table table(makeResult(state.range(0)), pictures(), state.range(0));
    table.card->layoutIfNeeded();
    for (auto _ : state)
        benchmark::DoNotOptimize(snapshotOf(*table.card, Scale));
    perRow(state, state.range(0));
}

/// From the first row to the last, eight in sight, a row a step.
void scrollThrough(benchmark::State& state) {
    useScreen();
    const Table table(makeResult(state.range(0)), pictures(), RowsInSight);
    table.card->layoutIfNeeded();
    for (auto _ : state) {
        table.table->setContentOffset({0, 0});
        table.card->layoutIfNeeded();
        while (table.table->scrollBy({0, RowHeight}))
            table.card->layoutIfNeeded();
    }
    perRow(state, state.range(0));
    state.counters["cells"] = static_cast<double>(table.table->subviews().size());
}

using enum benchmark::TimeUnit;
BENCHMARK(makeCell)->Unit(kMicrosecond);
BENCHMARK(reuseCell)->Unit(kMicrosecond);
BENCHMARK(layOutAtAnotherWidth)->Arg(8)->Arg(100)->Unit(kMicrosecond);
BENCHMARK(layOutAtAnotherRowHeight)->Arg(8)->Arg(100)->Unit(kMicrosecond);
BENCHMARK(layOutUnchanged)->Arg(8)->Arg(100)->Unit(kMicrosecond);
BENCHMARK(firstPaint)->Arg(8)->Arg(100)->Unit(kMicrosecond);
BENCHMARK(paintAgain)->Arg(8)->Arg(100)->Unit(kMicrosecond);
BENCHMARK(scrollThrough)->Arg(100)->Arg(1000)->Unit(kMicrosecond);

} // namespace
