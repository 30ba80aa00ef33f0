#pragma once

#include "fetching/FetchingFakes.h"
#include "platform/favorites/FavoritesStore.h"
#include "platform/favorites/TransitStorageLineItem.h"
#include "platform/foundation/CodingClass.h"
#include "platform/foundation/RunLoop.h"
#include "platform/geoservices/TransitIncidentRecord.h"
#include "platform/uikit/UIViewControllerTransitionCoordinator.h"
#include "support/LogCapture.h"
#include "support/TemporaryProfile.h"
#include "support/TestClock.h"
#include "widget/OWTransitIncidentsViewController.h"

#include <gtest/gtest.h>

#include <functional>
#include <map>
#include <string>
#include <utility>
#include <vector>

namespace orvo::testing {

using Calls = std::vector<std::string>;

/// A host that does what the test says, and notes what it is asked.
class ScriptedContext final : public NSExtensionContext {
public:
    explicit ScriptedContext(Calls& calls)
        : _calls(calls) {}
    void openURL_completionHandler(const std::shared_ptr<NSURL>&,
                                   std::function<void(bool)>) override {
        _calls.emplace_back("open URL");
    }
    NCWidgetDisplayMode widgetActiveDisplayMode() const override { return mode; }
    NCWidgetDisplayMode widgetLargestAvailableDisplayMode() const override { return largest; }
    void setWidgetLargestAvailableDisplayMode(NCWidgetDisplayMode value) override {
        EXPECT_TRUE(RunLoop::isMainThread());
        largest = value;
        _calls.emplace_back(value == NCWidgetDisplayMode::Expanded ? "offers expanded"
                                                                   : "offers compact");
        if (whenOffered)
            whenOffered();
    }
    CGSize widgetMaximumSizeForDisplayMode(NCWidgetDisplayMode of) const override {
        return of == NCWidgetDisplayMode::Expanded ? expandedMaximum : compactMaximum;
    }

    NCWidgetDisplayMode mode = NCWidgetDisplayMode::Compact;
    NCWidgetDisplayMode largest = NCWidgetDisplayMode::Compact;
    CGSize compactMaximum{359, 110};
    CGSize expandedMaximum{359, 616};
    std::function<void()> whenOffered;

private:
    Calls& _calls;
};

/// Notes its calls, and is otherwise a data source.
class RecordingDataSource final : public OWTransitIncidentDataSource {
public:
    static std::shared_ptr<RecordingDataSource> make(Calls& calls) {
        auto made = std::make_shared<RecordingDataSource>();
        made->_calls = &calls;
        made->_initWithTransitLineItemsResult_expanded_artworkCache_maxNumberOfRows_availableWidth(
            nullptr, false, nullptr, 100, 359);
        return made;
    }
    void updateTransitLineItemResult_captureAnalytics(
        const std::shared_ptr<Result>& result,
        const std::shared_ptr<OWTransitIncidentsAnalyticsDelegate>& analytics) override {
        note("update result");
        resultAnalytics = analytics;
        OWTransitIncidentDataSource::updateTransitLineItemResult_captureAnalytics(result,
                                                                                  analytics);
    }
    void recalculateDataSourceItemsWithAnalytics(
        const std::shared_ptr<OWTransitIncidentsAnalyticsDelegate>& analytics) override {
        note("recalculate");
        recalculateAnalytics = analytics;
        OWTransitIncidentDataSource::recalculateDataSourceItemsWithAnalytics(analytics);
    }
    void setRowHeight_maxNumberOfRows(double height, std::uint64_t rows) override {
        rowHeight = height;
        maxRows = rows;
        note("row height");
        OWTransitIncidentDataSource::setRowHeight_maxNumberOfRows(height, rows);
    }
    void setExpanded(bool expanded) override {
        note(expanded ? "expand" : "compact");
        OWTransitIncidentDataSource::setExpanded(expanded);
    }
    void setAvailableWidth(double width) override {
        note("width " + std::to_string(static_cast<int>(width)));
        OWTransitIncidentDataSource::setAvailableWidth(width);
    }
    CGSize preferredContentSizeForExpanded_maxSize(bool expanded, CGSize maximum) const override {
        _calls->push_back("preferred size for " + std::to_string(static_cast<int>(maximum.height)));
        return OWTransitIncidentDataSource::preferredContentSizeForExpanded_maxSize(expanded,
                                                                                    maximum);
    }

    std::shared_ptr<OWTransitIncidentsAnalyticsDelegate> resultAnalytics;
    std::shared_ptr<OWTransitIncidentsAnalyticsDelegate> recalculateAnalytics;
    double rowHeight = -1;
    std::uint64_t maxRows = 0;
    std::function<void(const std::string&)> whenCalled;

private:
    void note(const std::string& call) {
        _calls->push_back(call);
        if (whenCalled)
            whenCalled(call);
    }
    Calls* _calls = nullptr;
};

class RecordingAnalytics final : public OWTransitIncidentsAnalyticsDelegate {
public:
    explicit RecordingAnalytics(Calls& calls)
        : _calls(calls) {}
    void startSessionIfNeeded() override { _calls.emplace_back("start session"); }
    void recordCloseSessionSwiping() override { _calls.emplace_back("close session"); }
    void recordWidgetChangeDisplayMode(NCWidgetDisplayMode mode) override {
        _calls.push_back("record mode " + std::to_string(static_cast<int>(mode)));
    }
    void recordOpenItemAtIndexPath(const std::shared_ptr<NSIndexPath>& indexPath) override {
        _calls.push_back("record open " + std::to_string(indexPath->row()));
    }

private:
    Calls& _calls;
};

/// Notes its calls, and is otherwise an updater without line items.
class RecordingUpdater final : public OWTransitIncidentUpdater {
public:
    explicit RecordingUpdater(Calls& calls)
        : _calls(calls) {}
    void invalidate() override {
        _calls.emplace_back("invalidate");
        if (whenInvalidated)
            whenInvalidated();
        OWTransitIncidentUpdater::invalidate();
    }
    std::function<void()> whenInvalidated;

private:
    Calls& _calls;
};

class RecordingTable final : public UITableView {
public:
    explicit RecordingTable(Calls& calls)
        : _calls(calls) {}
    static std::shared_ptr<RecordingTable> make(Calls& calls) {
        auto table = std::make_shared<RecordingTable>(calls);
        table->_initWithFrame_style({}, UITableViewStyle::Plain);
        return table;
    }
    void reloadSections_withRowAnimation(const std::set<std::int64_t>& sections,
                                         UITableViewRowAnimation animation) override {
        _calls.push_back("reload " + std::to_string(*sections.begin()) +
                         (animation == UITableViewRowAnimation::Automatic ? " automatically" : ""));
    }

private:
    Calls& _calls;
};

/// Keeps what it is to run.
class FakeCoordinator final : public UIViewControllerTransitionCoordinator {
public:
    bool animateAlongsideTransition_completion(Block block, Block end) override {
        animation = std::move(block);
        hasCompletion = static_cast<bool>(end);
        return true;
    }
    Block animation;
    bool hasCompletion = true;
};

/// The classes that a saved state may hold.
inline std::shared_ptr<const CodingClassTable> savedClasses() {
    return std::make_shared<const CodingClassTable>(
        CodingClassTable{CodingClass::of<OWTransitIncidentViewControllerState>(
                             "OWTransitIncidentViewControllerState"),
                         CodingClass::of<TransitStorageLineItem>("TransitStorageLineItem"),
                         CodingClass::of<TransitStorageIncident>("TransitStorageIncident")});
}

/// A profile of its own, a lookup that answers as told, a stopped clock, and a scripted host.
class WidgetWorld : public ::testing::Test {
protected:
    using Controller = OWTransitIncidentsViewController;

    ~WidgetWorld() override {
        if (controller)
            controller->setUpdater(nullptr);
        EXPECT_EQ(RunLoop::main().scheduledTimers(), 0U);
    }

    std::shared_ptr<Controller> makeController() {
        auto made = Controller::initWithNibName_bundle(std::nullopt, nullptr);
        made->setExtensionContext(context);
        return made;
    }
    /// A controller whose view is loaded, then with doubles for what it owns.
    void loadWithDoubles() {
        controller = makeController();
        (void)controller->view();
        dataSource = RecordingDataSource::make(calls);
        dataSource->setDelegate(controller);
        controller->setDataSource(dataSource);
        controller->setTableView(RecordingTable::make(calls));
        controller->setAnalyticsDelegate(std::make_shared<RecordingAnalytics>(calls));
        calls.clear();
    }
    void saveFavorites(const std::vector<std::uint64_t>& muids) {
        std::shared_ptr<NSError> error;
        const auto store = FavoritesStore::open(
            FavoritesStore::standardPath(), FavoritesStore::Access::Write, &error);
        ASSERT_TRUE(store) << descriptionOf(error);
        for (const std::uint64_t muid : muids)
            ASSERT_EQ(store->addLine(*makeLine(muid)), nullptr);
    }
    static bool runUntil(const std::function<bool()>& done) {
        for (int turn = 0; turn < 3000; ++turn)
            if (RunLoop::main().runUntil(done, 0.01))
                return true;
        return false;
    }
    void runUntilFetched() {
        ASSERT_TRUE(runUntil([this] { return controller->request() == nullptr; }));
    }
    static std::shared_ptr<Result> success(NSArray::Elements lines = {}) {
        return Result::resultWithValue(NSArray::arrayWithObjects(std::move(lines)));
    }
    /// A line with an advisory of that title, which goes on.
    static std::shared_ptr<NSObject> disturbedLine(std::uint64_t muid, const char* title) {
        return makeItem(muid,
                        NSArray::arrayOf({TransitIncidentRecord::initWithFields(
                            {.muid = muid + 100, .title = title, .summary = "Some words"})}));
    }
    /// The titles of the rows of the present mode that are items.
    static std::vector<std::string> titles(const OWTransitIncidentDataSource& source) {
        std::vector<std::string> found;
        for (std::int64_t row = 0;; ++row) {
            const auto item = std::dynamic_pointer_cast<OWTransitItem>(
                source._itemAtIndexPath(NSIndexPath::indexPathForRow_inSection(row, 0)));
            if (!item || (row > 0 && !source.isExpanded()))
                return found;
            found.push_back(item->primaryText().value_or("(nil)"));
        }
    }
    static std::shared_ptr<NSError> someError() {
        return NSError::errorWithMessage("LookupDomain", 5, "no lookup today");
    }
    static std::shared_ptr<Result> failure() { return Result::resultWithError(someError()); }

private:
    RunLoop& _loop = RunLoop::main();
    TemporaryProfile _profile;

protected:
    Calls calls;
    LogCapture log;
    StoppedClock clock;
    std::shared_ptr<FakeLookup> lookup = std::make_shared<FakeLookup>();
    std::shared_ptr<ScriptedContext> context = std::make_shared<ScriptedContext>(calls);
    std::shared_ptr<RecordingDataSource> dataSource;
    std::shared_ptr<Controller> controller;

private:
    EnvironmentSlot<std::shared_ptr<LookupService>>::Override _lookup =
        LookupService::shared().overrideWith(lookup);
    EnvironmentSlot<std::shared_ptr<const CodingClassTable>>::Override _classes =
        CodingClassTable::current().overrideWith(savedClasses());
};

} // namespace orvo::testing
