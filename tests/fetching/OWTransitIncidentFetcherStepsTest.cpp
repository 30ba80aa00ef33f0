#include "fetching/FavoritesContainer_OWFavorites.h"
#include "fetching/FetchingFakes.h"
#include "fetching/OWTransitIncidentFetcher.h"
#include "fetching/_OWTransitIncidentFetcherRequest.h"
#include "platform/favorites/FavoritePlace.h"
#include "platform/favorites/FavoriteTransitLine.h"
#include "platform/favorites/FavoritesStore.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/Log.h"
#include "platform/foundation/RunLoop.h"
#include "shared/NSUserDefaults_OrvoGroup.h"
#include "support/LogCapture.h"
#include "support/TemporaryProfile.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <functional>
#include <memory>
#include <mutex>
#include <string>
#include <utility>
#include <vector>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using testing::LogCapture;
using testing::makeFavorite;
using testing::makeItem;
using testing::makeLine;
using testing::TemporaryProfile;

using Request = _OWTransitIncidentFetcherRequest;

constexpr NSTimeInterval turnSeconds = 0.01;
constexpr int mostTurns = 3000;

/// What happened, in its order, on whatever thread.
class Events {
public:
    void note(const std::string& event) {
        const std::lock_guard lock(_mutex);
        _events.push_back(event);
    }
    [[nodiscard]] std::vector<std::string> all() const {
        const std::lock_guard lock(_mutex);
        return _events;
    }

    void clear() {
        const std::lock_guard lock(_mutex);
        _events.clear();
    }

private:
    mutable std::mutex _mutex;
    std::vector<std::string> _events;
};

/// Notes what is asked of it and keeps the handler until the test answers.
class PendingLookup final : public LookupService {
public:
    explicit PendingLookup(std::shared_ptr<Events> events)
        : _events(std::move(events)) {}

    std::shared_ptr<LineItemTicket>
    ticketForTransitLines_traits(const std::shared_ptr<NSArray>& identifiers,
                                 const std::shared_ptr<NSObject>& /*traits*/) override {
        std::string asked = "a ticket for";
        for (const auto& identifier : typed<MapItemIdentifier>(identifiers))
            asked += " " + std::to_string(identifier->muid());
        _events->note(asked);
        return std::make_shared<Ticket>(strong(this));
    }
    [[nodiscard]] bool isPending() const {
        const std::lock_guard lock(_mutex);
        return static_cast<bool>(_handler);
    }
    void answer(const std::shared_ptr<NSArray>& items,
                const std::shared_ptr<NSError>& error = nullptr) {
        std::unique_lock lock(_mutex);
        const auto handler = std::exchange(_handler, nullptr);
        lock.unlock();
        _events->note("the answer");
        handler(items, error);
    }

private:
    class Ticket final : public LineItemTicket {
    public:
        explicit Ticket(std::shared_ptr<PendingLookup> lookup)
            : _lookup(std::move(lookup)) {}
        void submitWithHandler_networkActivity(Handler handler,
                                               NetworkActivity /*networkActivity*/) override {
            _lookup->_events->note("its submission");
            const std::lock_guard lock(_lookup->_mutex);
            _lookup->_handler = std::move(handler);
        }

    private:
        std::shared_ptr<PendingLookup> _lookup;
    };

    std::shared_ptr<Events> _events;
    mutable std::mutex _mutex;
    LineItemTicket::Handler _handler;
};

/// A profile without favourites, and a lookup that waits for the test.
class IncidentFetcherSteps : public ::testing::Test {
protected:
    /// Asks again after short turns too: what another thread does wakes nobody.
    static bool runUntil(const std::function<bool()>& done) {
        for (int turn = 0; turn < mostTurns; ++turn)
            if (RunLoop::main().runUntil(done, turnSeconds))
                return true;
        return false;
    }
    void fetchToTheEnd() {
        const auto request = OWTransitIncidentFetcher::init()
                                 ->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(nullptr);
        ASSERT_TRUE(runUntil([&] { return lookup->isPending() || request->result(); }));
        if (lookup->isPending())
            lookup->answer(NSArray::array());
    }
    /// As if the container had given these. Nothing runs on another thread.
    void fetchFavorites(NSArray::Elements favorites) const {
        OWTransitIncidentFetcher::init()->_fetchIncidentsForFavorites_withRequest(
            NSArray::arrayWithObjects(std::move(favorites)),
            Request::initWithCompletionHandler(
                [this](const auto&) { events->note("the handler"); }));
    }
    static void saveLine(std::uint64_t muid) {
        std::shared_ptr<NSError> error;
        const auto store = FavoritesStore::open(
            FavoritesStore::standardPath(), FavoritesStore::Access::Write, &error);
        ASSERT_TRUE(store) << descriptionOf(error);
        ASSERT_EQ(store->addLine(*makeLine(muid)), nullptr);
    }

private:
    RunLoop& _loop = RunLoop::main(); // the thread of the tests is the main thread
    TemporaryProfile _profile;
    LogCapture _log;

protected:
    std::shared_ptr<Events> events = std::make_shared<Events>();
    std::shared_ptr<PendingLookup> lookup = std::make_shared<PendingLookup>(events);

private:
    EnvironmentSlot<std::shared_ptr<LookupService>>::Override _lookup =
        LookupService::shared().overrideWith(lookup);
    EnvironmentSlot<LogSink>::Override _sink =
        Log::sink().overrideWith([events = events](const LogRecord& record) {
            if (record.category == "TransitWidget")
                events->note(record.redacted);
        });
};

TEST_F(IncidentFetcherSteps, ComeInThisOrder) {
    const auto random = Environment::random().overrideWith([this] {
        events->note("a draw");
        return 1U;
    });
    OrvoGroup::__orvo_groupUserDefaults()->setBool_forKey(
        true, "Orvo.TransitWidget.internal.injectFakeIncidents");
    saveLine(7);
    const auto request =
        OWTransitIncidentFetcher::init()->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(
            [this](const auto&) { events->note("the fetch's handler"); });
    request->addHandler([this](const auto&) { events->note("a joined handler"); });
    ASSERT_TRUE(runUntil([this] { return lookup->isPending(); }));
    lookup->answer(NSArray::arrayOf({makeItem(7)}));
    auto seen = events->all();
    seen.erase(std::unique(seen.begin(), seen.end()), seen.end()); // a fake draws more than once
    EXPECT_THAT(seen,
                ElementsAre("Received 1 favorites from container.",
                            "Issuing favorite lines lookup request for Muids: <private>.",
                            "a ticket for 7",
                            "its submission",
                            "the answer",
                            "a draw",
                            "Received 1 line items.",
                            "the fetch's handler",
                            "a joined handler"));
}

TEST_F(IncidentFetcherSteps, AnErrorIsToldToTheLogBeforeAnybodyElse) {
    fetchFavorites({makeFavorite(7)});
    lookup->answer(nullptr, NSError::errorWithMessage("TestDomain", 1, "no network"));
    EXPECT_THAT(events->all(),
                ElementsAre("Received 1 favorites from container.",
                            "Issuing favorite lines lookup request for Muids: <private>.",
                            "a ticket for 7",
                            "its submission",
                            "the answer",
                            "Received error: <private>.",
                            "the handler"));
}

TEST_F(IncidentFetcherSteps, WithoutLinesTheLogIsWrittenAtOnceAndTheHandlerComesLater) {
    for (const auto& favorites :
         {NSArray::array(),
          NSArray::arrayOf({FavoritePlace::initWithName_latitude_longitude("Home", 1, 2)})}) {
        events->clear();
        const std::string count = std::to_string(favorites->count());
        fetchFavorites(favorites->elements());
        const std::vector<std::string> logged = {"Received " + count + " favorites from container.",
                                                 "0 Favorite lines, returning early."};
        EXPECT_EQ(events->all(), logged);
        RunLoop::main().runOnce();
        EXPECT_THAT(events->all(), ElementsAre(logged[0], logged[1], "the handler"));
    }
    EXPECT_FALSE(lookup->isPending());
}

TEST_F(IncidentFetcherSteps, WhetherIncidentsAreFakeIsAskedWhenTheAnswerHasCome) {
    const auto random = Environment::random().overrideWith([this] {
        events->note("a draw");
        return 1U;
    });
    const auto defaults = OrvoGroup::__orvo_groupUserDefaults();
    constexpr const char* Key = "Orvo.TransitWidget.internal.injectFakeIncidents";
    fetchFavorites({makeFavorite(7)});
    defaults->setBool_forKey(true, Key);
    lookup->answer(NSArray::arrayOf({makeItem(7)}));
    EXPECT_GT(std::ranges::count(events->all(), "a draw"), 0);

    events->clear();
    fetchFavorites({makeFavorite(7)});
    defaults->setBool_forKey(false, Key);
    lookup->answer(NSArray::arrayOf({makeItem(7)}));
    EXPECT_EQ(std::ranges::count(events->all(), "a draw"), 0);
}

TEST_F(IncidentFetcherSteps, WhateverAdoptsTheProtocolIsAFavoriteLine) {
    class OtherFavorite final : public FavoriteTransitLine {
    public:
        [[nodiscard]] std::shared_ptr<TransitLine> transitLine() const override {
            return makeLine(9);
        }
    };
    fetchFavorites({std::make_shared<OtherFavorite>()});
    EXPECT_EQ(std::ranges::count(events->all(), "a ticket for 9"), 1);
}

TEST_F(IncidentFetcherSteps, ALookupKeepsFetcherAndRequestUntilItHasAnswered) {
    // The last owners but the lookup go with this scope. Nothing runs on another thread.
    std::weak_ptr<OWTransitIncidentFetcher> fetcherWatch;
    std::weak_ptr<Request> requestWatch;
    bool ended = false;
    {
        const auto fetcher = OWTransitIncidentFetcher::init();
        const auto request = Request::initWithCompletionHandler([&](const auto&) { ended = true; });
        fetcherWatch = fetcher;
        requestWatch = request;
        fetcher->_fetchIncidentsForFavorites_withRequest(NSArray::arrayOf({makeFavorite(7)}),
                                                         request);
    }
    ASSERT_TRUE(lookup->isPending());
    EXPECT_FALSE(fetcherWatch.expired());
    EXPECT_FALSE(requestWatch.expired());
    EXPECT_FALSE(ended);
    lookup->answer(NSArray::array());
    EXPECT_TRUE(ended);
    EXPECT_TRUE(fetcherWatch.expired());
    EXPECT_TRUE(requestWatch.expired());
}

TEST_F(IncidentFetcherSteps, EveryFetchReadsThroughTheOneContainerOfTheProcess) {
    saveLine(7);
    fetchToTheEnd();
    EXPECT_EQ(OWFavorites::defaultContainer()->unreadable(), nullptr);

    // Where it can read no more, a container gives what it read last; another one has nothing.
    std::filesystem::remove(FavoritesStore::standardPath());
    std::filesystem::create_directory(FavoritesStore::standardPath());
    fetchToTheEnd();
    EXPECT_NE(OWFavorites::defaultContainer()->unreadable(), nullptr);
    EXPECT_EQ(std::ranges::count(events->all(), "a ticket for 7"), 2);
}

} // namespace
} // namespace orvo
