#include "platform/feeds/FeedLookupFixture.h"
#include "platform/foundation/NSBundle.h"
#include "platform/geoservices/LocalAnalyticsStore.h"
#include "platform/launchservices/ApplicationLauncher.h"
#include "platform/launchservices/ApplicationProxy.h"
#include "platform/launchservices/PlugInKitProxy.h"
#include "platform/mapuikit/FeedLookupService.h"
#include "widget/WidgetWorld.h"

#include <gmock/gmock.h>

#include <atomic>

namespace orvo {
namespace {

using testing::AlertEntity;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

/// The map application, which takes everything.
class TakingLauncher final : public ApplicationLauncher {
public:
    void openURLs(const std::string&,
                  const std::vector<std::string>& urls,
                  CompletionHandler handler) override {
        take(urls.at(0), std::move(handler));
    }
    void activateAction(const std::string&,
                        const std::string& action,
                        const std::shared_ptr<NSData>& parameter,
                        CompletionHandler handler) override {
        EXPECT_TRUE(parameter);
        take(action, std::move(handler));
    }
    std::vector<std::string> taken;

private:
    void take(const std::string& what, CompletionHandler handler) {
        taken.push_back(what);
        DispatchQueue::mainQueue()->async([handler = std::move(handler)] { handler(nullptr); });
    }
};

/// The widget over favourites, feeds, archives and records as they are in the program; its host,
/// the clock, the feed's bytes and the map application do as the test says. The feed is read on
/// worker threads.
class WidgetRun : public testing::FeedLookupFixture {
protected:
    using Mode = NCWidgetDisplayMode;

    WidgetRun() {
        const auto favorites = FavoritesStore::open(
            FavoritesStore::standardPath(), FavoritesStore::Access::Write, nullptr);
        for (const char* route : {"1", "2"})
            EXPECT_EQ(favorites->addLine(*testing::makeLine(city(route))), nullptr);
        whenAsked = [this] {
            EXPECT_FALSE(RunLoop::isMainThread());
            ++fetches;
        };
    }
    ~WidgetRun() override { EXPECT_EQ(loop.scheduledTimers(), 0U); }

    /// From now on the feed holds these alerts, and was got `seconds` after the beginning.
    void publish(double seconds, const std::vector<AlertEntity>& alerts) {
        answers["city/alerts"] =
            body(testing::alertMessage(NowTimestamp + static_cast<std::uint64_t>(seconds), alerts),
                 Now + seconds);
    }
    static AlertEntity alertOf(const char* route,
                               const char* title,
                               std::optional<std::uint64_t> start = {},
                               std::optional<std::uint64_t> end = {}) {
        const auto at = [](std::optional<std::uint64_t> seconds) {
            return seconds ? std::optional(NowTimestamp + *seconds) : std::nullopt;
        };
        return {
            .id = title, .routes = {route}, .header = title, .start = at(start), .end = at(end)};
    }
    void turnClockTo(double seconds) {
        clock->setSince1970(Now + seconds);
        loop.checkTimers();
    }
    void begin() {
        controller = OWTransitIncidentsViewController::initWithNibName_bundle({}, nullptr);
        controller->setExtensionContext(context);
        (void)controller->view();
    }
    void appear() {
        controller->viewWillAppear(false);
        controller->viewDidAppear(false);
    }
    void disappear() {
        controller->viewWillDisappear(false);
        controller->viewDidDisappear(false);
    }
    void showMode(Mode mode) {
        context->mode = mode;
        controller->widgetActiveDisplayModeDidChange_withMaximumSize(
            mode, context->widgetMaximumSizeForDisplayMode(mode));
    }
    bool runUntilFetched() {
        constexpr double Patience = 30;
        return loop.runUntil([this] { return controller->request() == nullptr; }, Patience);
    }
    std::vector<std::string> expandedTitles() const {
        std::vector<std::string> titles;
        for (const auto& item :
             typed<OWTransitItem>(controller->dataSource()->listItem()->expandedItems()))
            titles.push_back(item->primaryText().value_or("(nil)"));
        return titles;
    }
    std::int64_t rows() const { return controller->tableView()->numberOfRowsInSection(0); }

    RunLoop& loop = RunLoop::main();
    testing::LogCapture log;
    testing::Calls calls;
    std::atomic<int> fetches = 0;
    std::shared_ptr<testing::ScriptedContext> context =
        std::make_shared<testing::ScriptedContext>(calls);
    std::shared_ptr<TakingLauncher> launcher = std::make_shared<TakingLauncher>();
    std::shared_ptr<OWTransitIncidentsViewController> controller;

private:
    EnvironmentSlot<std::shared_ptr<NSBundle>>::Override _bundle =
        NSBundle::main().overrideWith(NSBundle::bundleWithPath(ORVO_TEST_RESOURCES));
    EnvironmentSlot<std::shared_ptr<LookupService>>::Override _lookup =
        LookupService::shared().overrideWith(
            FeedLookupService::initWithLookup_updater(FeedLookup::make(ground()), nullptr));
    EnvironmentSlot<std::shared_ptr<ApplicationLauncher>>::Override _launcher =
        ApplicationLauncher::launcher().overrideWith(launcher);
    EnvironmentSlot<std::shared_ptr<BundleProxy>>::Override _process =
        BundleProxy::currentProcess().overrideWith(
            PlugInKitProxy::pluginKitProxyForIdentifier_containingBundle(
                "a.widget", ApplicationProxy::applicationProxyForIdentifier("a.map")));
    EnvironmentSlot<std::shared_ptr<const CodingClassTable>>::Override _classes =
        CodingClassTable::current().overrideWith(testing::savedClasses());
};

TEST_F(WidgetRun, FromWhatWasSavedToATapAndBack) {
    // A life before: one line is disturbed.
    publish(0, {alertOf("1", "Works")});
    begin();
    appear();
    ASSERT_TRUE(runUntilFetched());
    disappear();
    EXPECT_EQ(fetches, 1);

    // The next one shows that before anything is fetched, and watches nothing of it.
    publish(0, {alertOf("1", "Works", {}, 600), alertOf("2", "Delays", 300)});
    begin();
    EXPECT_THAT(expandedTitles(), ElementsAre("Works", "Good service"));
    appear();
    EXPECT_EQ(context->largest, Mode::Expanded);
    EXPECT_EQ(controller->transitLineItemResult(), nullptr);
    EXPECT_EQ(controller->updater(), nullptr);

    // Two updates of the host join the fetch that the appearance has begun.
    std::vector<NCUpdateResult> answered;
    for (int hosts = 0; hosts < 2; ++hosts)
        controller->widgetPerformUpdateWithCompletionHandler([&](NCUpdateResult result) {
            EXPECT_TRUE(RunLoop::isMainThread());
            EXPECT_TRUE(controller->transitLineItemResult());
            answered.push_back(result);
        });
    ASSERT_TRUE(loop.runUntil([&] { return answered.size() == 2; }, 30));
    EXPECT_THAT(answered, ElementsAre(NCUpdateResult::NewData, NCUpdateResult::NewData));
    EXPECT_EQ(fetches, 2);
    EXPECT_EQ(controller->request(), nullptr);
    EXPECT_THAT(expandedTitles(), ElementsAre("Works", "Good service"));
    ASSERT_TRUE(controller->updater());
    EXPECT_EQ(controller->updater()->refreshInterval(), 1800);
    EXPECT_EQ(controller->updater()->lineItems()->count(), 2U);
    EXPECT_EQ(controller->updater()->updateDates()->count(), 2U);

    // The host shows it expanded.
    EXPECT_EQ(rows(), 1);
    showMode(Mode::Expanded);
    EXPECT_EQ(rows(), 2);
    EXPECT_EQ(controller->preferredContentSize(), (CGSize{359, 220}));

    // An incident begins, another ends: the rows follow without a fetch.
    turnClockTo(300.5);
    EXPECT_THAT(expandedTitles(), ElementsAre("Works", "Delays"));
    turnClockTo(600.5);
    EXPECT_THAT(expandedTitles(), ElementsAre("Delays", "Good service"));
    EXPECT_EQ(rows(), 2);
    EXPECT_EQ(controller->request(), nullptr);
    EXPECT_EQ(fetches, 2);

    // Half an hour after the fetch there is another.
    const auto watching = controller->updater();
    publish(1981, {alertOf("1", "Closed")});
    turnClockTo(1981);
    ASSERT_TRUE(controller->request());
    ASSERT_TRUE(runUntilFetched());
    EXPECT_EQ(fetches, 3);
    EXPECT_THAT(expandedTitles(), ElementsAre("Closed", "Good service"));
    EXPECT_NE(controller->updater(), watching);
    EXPECT_FALSE(watching->_autoRefreshTimer()->isValid());

    // A tap opens the map application and ends the session.
    ASSERT_TRUE(controller->tableView()->_pressRowAtIndexPath(
        NSIndexPath::indexPathForRow_inSection(0, 0)));
    loop.runOnce();
    EXPECT_THAT(launcher->taken, ElementsAre("ContinueUserActivity"));
    const auto sessions = LocalAnalyticsStore::sessions(10, nullptr).value();
    ASSERT_EQ(sessions.size(), 2U) << "that of the life before, and this one";
    EXPECT_EQ(sessions[0].endState, 1);
    EXPECT_EQ(sessions[0].tappedItemIndex, 1) << "the first expanded row counts as 1";
    EXPECT_EQ(sessions[0].duration, 1981);
    EXPECT_TRUE(sessions[0].everExpanded);
    EXPECT_NE(sessions[1].endState, 1);

    // It disappears; what it showed is there at the next start, however long that takes.
    disappear();
    EXPECT_EQ(loop.scheduledTimers(), 0U);
    turnClockTo(86400);
    begin();
    EXPECT_THAT(expandedTitles(), ElementsAre("Closed", "Good service"));
    EXPECT_EQ(rows(), 2) << "and it is expanded";
    EXPECT_EQ(fetches, 3);
}

TEST_F(WidgetRun, AFailureIsARowUntilTheNextFetch) {
    publish(0, {alertOf("1", "Works")});
    begin();
    appear();
    ASSERT_TRUE(runUntilFetched());
    showMode(Mode::Expanded);
    ASSERT_EQ(rows(), 2);

    failWith("city/alerts", "no answer");
    std::optional<NCUpdateResult> answer;
    controller->widgetPerformUpdateWithCompletionHandler(
        [&](NCUpdateResult result) { answer = result; });
    ASSERT_TRUE(runUntilFetched());
    EXPECT_EQ(answer, NCUpdateResult::Failed);
    EXPECT_EQ(controller->updater(), nullptr);
    EXPECT_EQ(loop.scheduledTimers(), 0U);
    EXPECT_EQ(context->largest, Mode::Compact);
    EXPECT_EQ(rows(), 0) << "until the host shows the mode that is left";
    EXPECT_EQ(controller->preferredContentSize().height, 0);
    showMode(Mode::Compact);
    EXPECT_EQ(rows(), 1);
    EXPECT_THAT(expandedTitles(), IsEmpty());

    // The failure is what is kept, too.
    disappear();
    begin();
    EXPECT_FALSE(controller->dataSource()->transitLineItemResult()->isSuccess());
    appear();
    ASSERT_TRUE(runUntilFetched());
    EXPECT_FALSE(controller->dataSource()->transitLineItemResult()->isSuccess());
    publish(0, {alertOf("1", "Works")});
    controller->_fetchUpdatesWithCompletitionHandler({});
    ASSERT_TRUE(runUntilFetched());
    EXPECT_THAT(expandedTitles(), ElementsAre("Works", "Good service"));
    disappear();
}

} // namespace
} // namespace orvo
