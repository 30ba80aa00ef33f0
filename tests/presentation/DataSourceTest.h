#pragma once

#include "presentation/ArtworkColumn.h"
#include "presentation/OWTransitIncidentDataSource.h"
#include "support/LogCapture.h"
#include "viewmodel/BuilderWorld.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>
#include <string>
#include <utility>
#include <vector>

namespace orvo::testing {

inline constexpr std::uint64_t NoLimit = std::numeric_limits<std::uint64_t>::max();
using Lines = std::vector<std::shared_ptr<TransitLineItem>>;

inline std::shared_ptr<Result> success(const Lines& lines) {
    return Result::resultWithValue(NSArray::arrayOf(lines));
}

inline std::shared_ptr<Result> failure() {
    return Result::resultWithError(NSError::errorWithMessage("LookupDomain", 5, "no lookup"));
}

/// One line with one advisory.
inline Lines oneAdvisory() {
    return {line(1, {incident(11)})};
}
inline Lines oneAdvisoryAndAClearLine() {
    return {line(1, {incident(11)}), line(2, {})};
}
inline Lines twoAdvisories() {
    return {line(1, {incident(11)}), line(2, {incident(12)})};
}
/// As many lines as shields, each with an advisory.
inline Lines advisoriesWithShields(const std::vector<const char*>& shields) {
    Lines lines;
    std::uint64_t number = 0;
    for (const char* shield : shields) {
        ++number;
        lines.push_back(line(number, {incident(100 + number)}, {.alternate = artwork(shield)}));
    }
    return lines;
}

class Delegate final : public OWTransitIncidentDataSourceDelegate {
public:
    void dataSource_didSelectOpenableItem_atIndexPath(
        const std::shared_ptr<OWTransitIncidentDataSource>&,
        const std::shared_ptr<OWOpenable>& item,
        const std::shared_ptr<NSIndexPath>& indexPath) override {
        calls.push_back("select " + std::to_string(indexPath->row()));
        selected = item;
    }
    void dataSourceDidUpdateContent(
        const std::shared_ptr<OWTransitIncidentDataSource>& dataSource) override {
        calls.push_back("content " +
                        std::to_string(dataSource->tableView_numberOfRowsInSection(nullptr, 0)));
        heights.push_back(dataSource->preferredContentSizeForExpanded_maxSize(false, {}).height);
    }
    std::vector<std::string> calls;
    std::vector<double> heights; ///< that were preferred at each change of content
    std::shared_ptr<OWOpenable> selected;
};

class Analytics final : public OWTransitIncidentsAnalyticsDelegate {
public:
    void recordInfoForLines_incidentDisplayed_incidentsToLineMapping(
        const std::shared_ptr<NSArray>&,
        const std::shared_ptr<NSArray>& incidents,
        const std::shared_ptr<NSMapTable>&) override {
        displayed.push_back(incidents->count());
    }
    std::vector<std::size_t> displayed;
};

/// Notes what it is told, and is otherwise a table.
class RecordingTable final : public UITableView {
public:
    static std::shared_ptr<RecordingTable> make() {
        auto table = std::make_shared<RecordingTable>();
        table->_initWithFrame_style({{0, 0}, {359, 1000}}, UITableViewStyle::Plain);
        return table;
    }
    void registerClass_forCellReuseIdentifier(CellClass cellClass,
                                              const std::string& identifier) override {
        calls.push_back("register " + identifier);
        UITableView::registerClass_forCellReuseIdentifier(std::move(cellClass), identifier);
    }
    void setTableFooterView(const std::shared_ptr<UIView>& view) override {
        calls.emplace_back("footer");
        UITableView::setTableFooterView(view);
    }
    void setDelegate(const std::shared_ptr<UITableViewDelegate>& delegate) override {
        calls.emplace_back("delegate");
        UITableView::setDelegate(delegate);
    }
    void setDataSource(const std::shared_ptr<UITableViewDataSource>& dataSource) override {
        calls.emplace_back("data source");
        UITableView::setDataSource(dataSource);
    }
    void deselectRowAtIndexPath_animated(const std::shared_ptr<NSIndexPath>& indexPath,
                                         bool animated) override {
        calls.push_back("deselect " + std::to_string(indexPath->row()) +
                        (animated ? " animated" : ""));
        UITableView::deselectRowAtIndexPath_animated(indexPath, animated);
    }
    std::vector<std::string> calls;
};

inline std::shared_ptr<NSIndexPath> row(std::int64_t number, std::int64_t section = 0) {
    return NSIndexPath::indexPathForRow_inSection(number, section);
}

/// A data source whose delegate notes what it hears, over shields of widths that the test says.
class DataSourceTest : public ::testing::Test {
protected:
    struct Options {
        bool expanded = false;
        std::uint64_t maxRows = NoLimit;
        double width = 359;
    };
    /// With the delegate of this test.
    std::shared_ptr<OWTransitIncidentDataSource> make(std::shared_ptr<Result> result,
                                                      Options options) {
        auto made = OWTransitIncidentDataSource::
            initWithTransitLineItemsResult_expanded_artworkCache_maxNumberOfRows_availableWidth(
                std::move(result), options.expanded, cache, options.maxRows, options.width);
        made->setDelegate(delegate);
        return made;
    }
    std::shared_ptr<OWTransitIncidentDataSource> make(std::shared_ptr<Result> result) {
        return make(std::move(result), Options());
    }
    static std::int64_t rowsOf(OWTransitIncidentDataSource& source) {
        return source.tableView_numberOfRowsInSection(nullptr, 0);
    }
    static std::vector<std::string> texts(const std::shared_ptr<NSArray>& items) {
        std::vector<std::string> texts;
        for (const auto& one : typed<OWTransitItem>(items))
            texts.push_back(one->primaryText().value_or("(nil)"));
        return texts;
    }
    /// The size of a row's shield; -1 where it has none.
    static std::int64_t shieldSizeOf(const std::shared_ptr<NSObject>& item) {
        const auto row = std::dynamic_pointer_cast<OWTransitItem>(item);
        const auto sized =
            row && row->artwork()
                ? std::dynamic_pointer_cast<SizedTransitArtwork>(row->artwork()->artworkSource())
                : nullptr;
        return sized ? sized->shieldSize() : -1;
    }
    std::shared_ptr<RecordingTable> table(const std::shared_ptr<OWTransitIncidentDataSource>& of) {
        auto made = RecordingTable::make();
        of->configureTableView(made);
        return made;
    }

    BuilderWorld world;
    LogCapture log;
    std::shared_ptr<WidthsCache> cache = std::make_shared<WidthsCache>();
    std::shared_ptr<Delegate> delegate = std::make_shared<Delegate>();
    std::shared_ptr<Analytics> analytics = std::make_shared<Analytics>();
};

} // namespace orvo::testing
