#include "platform/foundation/NSNotificationCenter.h"
#include "widget/WidgetWorld.h"

#include <gmock/gmock.h>

// Where the controller calls its base class, and in which order it puts its table together.

namespace orvo {
namespace {

using testing::Calls;
using ::testing::Contains;
using ::testing::ElementsAre;
using testing::FakeCoordinator;
using ::testing::IsEmpty;
using ::testing::Not;
using testing::RecordingAnalytics;
using testing::RecordingDataSource;
using testing::RecordingUpdater;

/// Notes who serves it, and where it is put.
class WatchedTable final : public UITableView {
public:
    WatchedTable(Calls& calls, std::function<bool()> hasDelegate)
        : _calls(calls)
        , _hasDelegate(std::move(hasDelegate)) {}
    static std::shared_ptr<WatchedTable> make(Calls& calls, std::function<bool()> hasDelegate) {
        auto table = std::make_shared<WatchedTable>(calls, std::move(hasDelegate));
        table->_initWithFrame_style({}, UITableViewStyle::Plain);
        return table;
    }
    void setDataSource(const std::shared_ptr<UITableViewDataSource>& dataSource) override {
        note("configured");
        UITableView::setDataSource(dataSource);
    }
    void didMoveToSuperview() override { note("added"); }

private:
    void note(const std::string& what) {
        _calls.push_back(what + (_hasDelegate() ? ", with a delegate" : ", without a delegate"));
    }
    Calls& _calls;
    std::function<bool()> _hasDelegate;
};

/// Does nothing.
class SilentSource final : public DispatchSource {
public:
    void setEventHandler(DispatchQueue::Block) override {}
    void activate() override {}
    void cancel() override {}
};

/// Notes what its base class is told.
class WatchedController final : public OWTransitIncidentsViewController {
public:
    static std::shared_ptr<WatchedController> make(Calls& calls) {
        auto controller = std::make_shared<WatchedController>();
        controller->_calls = &calls;
        EXPECT_TRUE(controller->_initWithNibName_bundle(std::nullopt, nullptr));
        return controller;
    }
    void setTableView(std::shared_ptr<UITableView> tableView) override {
        if (!tableView)
            return;
        _calls->emplace_back("table");
        OWTransitIncidentsViewController::setTableView(
            WatchedTable::make(*_calls, [this] { return dataSource()->delegate() != nullptr; }));
    }
    std::function<void()> whenReached;

private:
    void _hasReachedBase(const char* call) override {
        _calls->push_back(std::string("base ") + call);
        if (!analyticsDelegate())
            _calls->emplace_back("no analytics yet");
        if (whenReached)
            whenReached();
    }
    Calls* _calls = nullptr;
};

class ControllerBase : public testing::WidgetWorld {
protected:
    void load() {
        watched = WatchedController::make(calls);
        watched->setExtensionContext(context);
        controller = watched;
        (void)controller->view();
    }
    /// Then with doubles for what it owns.
    void loadWithRecorders() {
        load();
        dataSource = RecordingDataSource::make(calls);
        dataSource->setDelegate(controller);
        controller->setDataSource(dataSource);
        controller->setAnalyticsDelegate(std::make_shared<RecordingAnalytics>(calls));
        calls.clear();
    }
    /// Whether a date that expires now changes its rows, as it does while it is visible.
    bool isVisible() {
        const auto before = calls.size();
        controller->transitIncidentUpdater_dateExpired(nullptr, NSDate::date());
        const bool isTold = calls.size() > before;
        calls.resize(before);
        return isTold;
    }
    std::shared_ptr<WatchedController> watched;
};

TEST_F(ControllerBase, IsMadeBeforeTheAnalytics) {
    watched = WatchedController::make(calls);
    EXPECT_THAT(calls, ElementsAre("base initWithNibName_bundle", "no analytics yet"));
    EXPECT_TRUE(watched->analyticsDelegate());
}

TEST_F(ControllerBase, LoadingGoesBaseThenMemoryThenTableConfiguredThenDelegateThenAdded) {
    const auto sources = DispatchSource::memoryPressureFactory().overrideWith(
        [this](MemoryPressure, const std::shared_ptr<DispatchQueue>&) {
            calls.emplace_back("source");
            return std::make_shared<SilentSource>();
        });
    watched = WatchedController::make(calls);
    watched->setExtensionContext(context);
    calls.clear();
    (void)watched->view();
    EXPECT_THAT(calls,
                ElementsAre("base viewDidLoad",
                            "source",
                            "source",
                            "source",
                            "source",
                            "table",
                            "configured, without a delegate",
                            "added, with a delegate"));
    EXPECT_EQ(watched->dataSource()->delegate(), watched);
    EXPECT_EQ(watched->tableView()->superview(), watched->view());
}

TEST_F(ControllerBase, HearsOfALayoutBeforeTheTableIsPlaced) {
    load();
    const auto view = controller->view();
    view->setFrame({{0, 0}, {359, 220}});
    view->layoutIfNeeded();
    calls.clear();
    const auto before = controller->tableView()->frame();
    watched->whenReached = [&] {
        EXPECT_EQ(controller->tableView()->frame(), before);
    };
    view->setFrame({{0, 0}, {300, 110}});
    view->layoutIfNeeded();
    EXPECT_THAT(calls, Contains("base viewWillLayoutSubviews"));
    EXPECT_EQ(controller->tableView()->frame(), (CGRect{{0, 0}, {300, 110}}));
}

TEST_F(ControllerBase, HearsOfAnAppearanceBeforeAnythingElseHappens) {
    loadWithRecorders();
    controller->setTransitLineItemResult(success());
    calls.clear();
    const auto observers = NSNotificationCenter::defaultCenter()->_observerCount();
    watched->whenReached = [&] {
        EXPECT_FALSE(isVisible());
        EXPECT_EQ(controller->updater(), nullptr);
        EXPECT_EQ(NSNotificationCenter::defaultCenter()->_observerCount(), observers);
    };
    controller->viewWillAppear(false);
    EXPECT_TRUE(isVisible());
    ASSERT_GE(calls.size(), 2U);
    EXPECT_EQ(calls[0], "base viewWillAppear");
    EXPECT_EQ(calls[1], "row height");
    watched->whenReached = nullptr;
    calls.clear();
    controller->viewDidAppear(false);
    EXPECT_THAT(calls, ElementsAre("base viewDidAppear", "start session"));
    runUntilFetched();
}

TEST_F(ControllerBase, HearsOfADisappearanceAfterAllThatIsDoneForIt) {
    loadWithRecorders();
    controller->viewWillAppear(false);
    runUntilFetched();
    controller->setUpdater(std::make_shared<RecordingUpdater>(calls));
    calls.clear();
    watched->whenReached = [&] {
        EXPECT_FALSE(isVisible());
        EXPECT_EQ(controller->updater(), nullptr);
    };
    controller->viewWillDisappear(false);
    EXPECT_THAT(calls, ElementsAre("invalidate", "base viewWillDisappear"));
    calls.clear();
    controller->viewDidDisappear(false);
    EXPECT_THAT(calls, ElementsAre("close session", "base viewDidDisappear"));
}

TEST_F(ControllerBase, IsNotToldOfATransition) {
    loadWithRecorders();
    const auto coordinator = std::make_shared<FakeCoordinator>();
    dataSource->whenCalled = [&](const std::string&) {
        EXPECT_FALSE(coordinator->animation) << "the width comes first";
    };
    controller->viewWillTransitionToSize_withTransitionCoordinator({320, 500}, coordinator);
    EXPECT_EQ(calls.front(), "width 320");
    constexpr const char* Transition = "base viewWillTransitionToSize_withTransitionCoordinator";
    EXPECT_THAT(calls, Not(Contains(Transition)));
    ASSERT_TRUE(coordinator->animation);
    calls.clear();
    coordinator->animation();
    EXPECT_THAT(calls, IsEmpty());
    // It would be noticed.
    controller->UIViewController::viewWillTransitionToSize_withTransitionCoordinator({}, nullptr);
    EXPECT_THAT(calls, ElementsAre(Transition));
}

TEST_F(ControllerBase, HearsOfAMemoryWarning) {
    load();
    calls.clear();
    controller->didReceiveMemoryWarning();
    EXPECT_THAT(calls, ElementsAre("base didReceiveMemoryWarning"));
}

} // namespace
} // namespace orvo
