#include "fetching/OWTransitIncidentFetcher.h"

#include "fetching/FetchingFakes.h"
#include "fetching/_OWTransitIncidentFetcherRequest.h"
#include "platform/favorites/FavoritesStore.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/RunLoop.h"
#include "shared/NSUserDefaults_OrvoGroup.h"
#include "support/LogCapture.h"
#include "support/TemporaryProfile.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <atomic>
#include <functional>
#include <vector>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using testing::FakeLookup;
using testing::LogCapture;
using testing::makeFavorite;
using testing::makeItem;
using testing::makeLine;
using testing::TemporaryProfile;

using Request = _OWTransitIncidentFetcherRequest;
using Results = std::vector<std::shared_ptr<Result>>;

const char* const injectKey = "Orvo.TransitWidget.internal.injectFakeIncidents";
constexpr NSTimeInterval turnSeconds = 0.01;
constexpr int mostTurns = 3000;

std::shared_ptr<NSError> makeError() {
    return NSError::errorWithMessage("LookupDomain", 5, "no lookup today");
}

std::shared_ptr<NSArray> valueOf(const std::shared_ptr<Result>& result) {
    std::shared_ptr<NSArray> array;
    result->withValue_orError(
        [&](const auto& value) { array = std::dynamic_pointer_cast<NSArray>(value); },
        [](const auto&) {});
    return array;
}

std::shared_ptr<NSError> errorOf(const std::shared_ptr<Result>& result) {
    std::shared_ptr<NSError> found;
    result->withValue_orError([](const auto&) {}, [&](const auto& error) { found = error; });
    return found;
}

/// A favourite of a kind that this program does not know.
class UnknownFavorite final : public virtual NSObject {};

/// A profile without favourites, a lookup without answers, and what the widget logs.
class IncidentFetcher : public ::testing::Test {
protected:
    /// The handler keeps what it is given in `results`, on the main thread.
    OWTransitIncidentFetcher::CompletionHandler keeping(Results& results) {
        return [&results](const std::shared_ptr<Result>& result) {
            results.push_back(result);
        };
    }
    /// Asks again after short turns too: what another thread does wakes nobody.
    static bool runUntil(const std::function<bool()>& done) {
        for (int turn = 0; turn < mostTurns; ++turn)
            if (RunLoop::main().runUntil(done, turnSeconds))
                return true;
        return false;
    }
    /// Runs until the answer to one fetch has come.
    std::shared_ptr<Result> fetch() {
        Results results;
        (void)OWTransitIncidentFetcher::init()
            ->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(keeping(results));
        EXPECT_TRUE(runUntil([&] { return !results.empty(); }));
        return results.empty() ? nullptr : results[0];
    }
    /// Goes on from favourites that the store would never answer.
    std::shared_ptr<Request> goOnFrom(const std::vector<std::shared_ptr<NSObject>>& favorites) {
        auto request = Request::initWithCompletionHandler(nullptr);
        OWTransitIncidentFetcher::init()->_fetchIncidentsForFavorites_withRequest(
            NSArray::arrayWithObjects(favorites), request);
        return request;
    }
    void saveLines(std::initializer_list<std::uint64_t> muids) {
        std::shared_ptr<NSError> error;
        const auto store = FavoritesStore::open(
            FavoritesStore::standardPath(), FavoritesStore::Access::Write, &error);
        ASSERT_TRUE(store) << descriptionOf(error);
        for (const std::uint64_t muid : muids)
            ASSERT_EQ(store->addLine(*makeLine(muid)), nullptr);
    }
    void savePlace(const char* name) {
        std::shared_ptr<NSError> error;
        const auto store = FavoritesStore::open(
            FavoritesStore::standardPath(), FavoritesStore::Access::Write, &error);
        ASSERT_TRUE(store) << descriptionOf(error);
        ASSERT_EQ(store->addPlace(*FavoritePlace::initWithName_latitude_longitude(name, 1, 2)),
                  nullptr);
    }
    std::vector<std::uint64_t> muidsAsked(std::size_t lookupNumber = 0) const {
        std::vector<std::uint64_t> muids;
        for (const auto& identifier :
             typed<MapItemIdentifier>(lookup->asked().at(lookupNumber).identifiers))
            muids.push_back(identifier->muid());
        return muids;
    }
    std::vector<LogRecord> widgetLog() const {
        std::vector<LogRecord> records;
        for (const auto& record : log.records())
            if (record.category == "TransitWidget")
                records.push_back(record);
        return records;
    }
    std::vector<std::string> widgetMessages() const {
        std::vector<std::string> messages;
        for (const auto& record : widgetLog())
            messages.push_back(record.message);
        return messages;
    }

private:
    RunLoop& _loop = RunLoop::main(); // the thread of the tests is the main thread
    TemporaryProfile _profile;

protected:
    LogCapture log;
    std::shared_ptr<FakeLookup> lookup = std::make_shared<FakeLookup>();

private:
    EnvironmentSlot<std::shared_ptr<LookupService>>::Override _lookup =
        LookupService::shared().overrideWith(lookup);
};

// The request

TEST_F(IncidentFetcher, AnswersAPendingRequestAtOnce) {
    Results results;
    const auto request =
        OWTransitIncidentFetcher::init()->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(
            keeping(results));
    ASSERT_TRUE(request);
    EXPECT_EQ(request->result(), nullptr);
    EXPECT_TRUE(results.empty());
    EXPECT_TRUE(runUntil([&] { return !results.empty(); }));
    EXPECT_EQ(request->result(), results[0]);
}

TEST_F(IncidentFetcher, AcceptsANilHandler) {
    const auto request =
        OWTransitIncidentFetcher::init()->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(
            nullptr);
    EXPECT_EQ(request->result(), nullptr);
    EXPECT_TRUE(runUntil([&] { return request->result() != nullptr; }));
    EXPECT_TRUE(request->result()->isSuccess());
}

TEST_F(IncidentFetcher, EachFetchHasARequestOfItsOwn) {
    const auto fetcher = OWTransitIncidentFetcher::init();
    const auto first = fetcher->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(nullptr);
    const auto second = fetcher->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(nullptr);
    EXPECT_NE(first, second);
    EXPECT_TRUE(runUntil([&] { return first->result() && second->result(); }));
    EXPECT_NE(first->result(), second->result());
}

TEST_F(IncidentFetcher, GoesOnWhenFetcherAndRequestAreDropped) {
    saveLines({1});
    lookup->answerWith({NSArray::array(), nullptr});
    Results results;
    {
        auto fetcher = OWTransitIncidentFetcher::init();
        auto request =
            fetcher->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(keeping(results));
        fetcher.reset();
        request.reset();
    }
    EXPECT_TRUE(runUntil([&] { return !results.empty(); }));
}

TEST_F(IncidentFetcher, LetsFetcherAndRequestGoAfterTheEnd) {
    saveLines({1});
    lookup->answerWith({NSArray::array(), nullptr});
    auto fetcher = OWTransitIncidentFetcher::init();
    auto request = fetcher->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(nullptr);
    EXPECT_TRUE(runUntil([&] { return request->result() != nullptr; }));
    const std::weak_ptr<NSObject> fetcherWatch = std::exchange(fetcher, nullptr);
    const std::weak_ptr<NSObject> requestWatch = std::exchange(request, nullptr);
    EXPECT_TRUE(runUntil([&] { return fetcherWatch.expired() && requestWatch.expired(); }));
}

TEST_F(IncidentFetcher, ALookupThatNeverAnswersLeavesTheRequestPending) {
    saveLines({1});
    const auto request =
        OWTransitIncidentFetcher::init()->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(
            nullptr);
    EXPECT_TRUE(runUntil([&] { return lookup->asked().size() == 1; }));
    RunLoop::main().runOnce();
    EXPECT_EQ(request->result(), nullptr);
    EXPECT_EQ(RunLoop::main().scheduledTimers(), 0U);
}

TEST_F(IncidentFetcher, OneReadingAndOneLookupServeAllLinesAndJoiners) {
    saveLines({1, 2, 3, 4, 5});
    lookup->answerWith({NSArray::array(), nullptr});
    Results results;
    const auto request =
        OWTransitIncidentFetcher::init()->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(
            keeping(results));
    for (int i = 0; i < 3; ++i)
        request->addHandler(keeping(results));
    EXPECT_TRUE(runUntil([&] { return results.size() == 4; }));
    EXPECT_EQ(results, Results(4, request->result()));
    EXPECT_EQ(muidsAsked(), (std::vector<std::uint64_t>{1, 2, 3, 4, 5}));
    EXPECT_EQ(lookup->asked().size(), 1U);
    EXPECT_EQ(lookup->asked()[0].submissions, 1);
    EXPECT_EQ(widgetMessages()[0], "Received 5 favorites from container.");
    EXPECT_EQ(widgetMessages().size(), 3U);
}

// Favourites

TEST_F(IncidentFetcher, WithoutFavoritesAnswersAnEmptyArrayOnTheMainQueueWithoutALookup) {
    bool onMainQueue = false;
    std::shared_ptr<Result> result;
    (void)OWTransitIncidentFetcher::init()->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(
        [&](const auto& given) {
            onMainQueue = DispatchQueue::mainQueue()->isCurrent() && RunLoop::isMainThread();
            result = given;
        });
    ASSERT_TRUE(runUntil([&] { return result != nullptr; }));
    EXPECT_TRUE(onMainQueue);
    ASSERT_TRUE(result->isSuccess());
    EXPECT_EQ(valueOf(result)->count(), 0U);
    EXPECT_TRUE(lookup->asked().empty());
    EXPECT_THAT(
        widgetMessages(),
        ElementsAre("Received 0 favorites from container.", "0 Favorite lines, returning early."));
}

TEST_F(IncidentFetcher, WithOnlyPlacesAnswersAsWithoutFavoritesButCountsThem) {
    savePlace("Home");
    savePlace("Work");
    const auto result = fetch();
    ASSERT_TRUE(result && result->isSuccess());
    EXPECT_EQ(valueOf(result)->count(), 0U);
    EXPECT_TRUE(lookup->asked().empty());
    EXPECT_THAT(
        widgetMessages(),
        ElementsAre("Received 2 favorites from container.", "0 Favorite lines, returning early."));
}

TEST_F(IncidentFetcher, TheEmptyAnswerComesLaterEvenOnTheMainQueue) {
    const auto request = goOnFrom({});
    EXPECT_EQ(request->result(), nullptr);
    RunLoop::main().runOnce();
    ASSERT_TRUE(request->result());
    EXPECT_EQ(valueOf(request->result())->count(), 0U);
}

TEST_F(IncidentFetcher, OnlyFavoritesThatHaveALineAreLookedUpInOrder) {
    (void)goOnFrom({makeFavorite(7),
                    FavoritePlace::initWithName_latitude_longitude("Home", 1, 2),
                    makeFavorite(3),
                    makeLine(8),
                    FavoriteTransitLineRecord::initWithTransitLine(nullptr),
                    std::make_shared<UnknownFavorite>(),
                    makeFavorite(5),
                    makeFavorite(3)});
    EXPECT_EQ(muidsAsked(), (std::vector<std::uint64_t>{7, 3, 5, 3}));
    EXPECT_EQ(widgetMessages()[0], "Received 8 favorites from container.");
}

TEST_F(IncidentFetcher, AFavoriteLineWithoutItsLineIsNoFavoriteLine) {
    const auto request = goOnFrom({FavoriteTransitLineRecord::initWithTransitLine(nullptr)});
    RunLoop::main().runOnce();
    ASSERT_TRUE(request->result());
    EXPECT_TRUE(lookup->asked().empty());
    EXPECT_THAT(
        widgetMessages(),
        ElementsAre("Received 1 favorites from container.", "0 Favorite lines, returning early."));
}

TEST_F(IncidentFetcher, NoFavoritesArrayReadsAsNoFavorites) {
    const auto request = Request::initWithCompletionHandler(nullptr);
    OWTransitIncidentFetcher::init()->_fetchIncidentsForFavorites_withRequest(nullptr, request);
    RunLoop::main().runOnce();
    ASSERT_TRUE(request->result());
    EXPECT_EQ(valueOf(request->result())->count(), 0U);
}

// The lookup

TEST_F(IncidentFetcher, LooksAllLinesUpWithOneTicketWithoutTraitsOrNetworkActivity) {
    (void)goOnFrom({makeFavorite(1), makeFavorite(2)});
    ASSERT_EQ(lookup->asked().size(), 1U);
    EXPECT_EQ(muidsAsked(), (std::vector<std::uint64_t>{1, 2}));
    EXPECT_EQ(lookup->asked()[0].traits, nullptr);
    EXPECT_EQ(lookup->asked()[0].submissions, 1);
    EXPECT_FALSE(lookup->asked()[0].withNetworkActivity);
}

std::shared_ptr<NSObject> favoriteWithoutIdentifier(std::uint64_t muid) {
    auto fields = testing::lineFields(muid, "Line");
    fields.identifier = nullptr;
    return FavoriteTransitLineRecord::initWithTransitLine(
        TransitLineRecord::initWithFields(std::move(fields)));
}

TEST_F(IncidentFetcher, LinesWithoutAnIdentifierDropOutOfTheLookup) {
    (void)goOnFrom({makeFavorite(1), favoriteWithoutIdentifier(2), makeFavorite(3)});
    EXPECT_EQ(muidsAsked(), (std::vector<std::uint64_t>{1, 3}));
}

TEST_F(IncidentFetcher, LinesWithoutAnyIdentifierStillLeadToALookupOfNothing) {
    lookup->answerWith({NSArray::array(), nullptr});
    const auto request = goOnFrom({favoriteWithoutIdentifier(2)});
    ASSERT_EQ(lookup->asked().size(), 1U);
    ASSERT_TRUE(lookup->asked()[0].identifiers);
    EXPECT_EQ(lookup->asked()[0].identifiers->count(), 0U);
    EXPECT_EQ(lookup->asked()[0].submissions, 1);
    EXPECT_TRUE(runUntil([&] { return request->result() != nullptr; }));
}

TEST_F(IncidentFetcher, TheLookupLineShowsTheIdentifiersAsPrivate) {
    (void)goOnFrom({makeFavorite(1), makeFavorite(2)});
    const auto records = widgetLog();
    ASSERT_EQ(records.size(), 2U);
    EXPECT_EQ(records[1].format, "Issuing favorite lines lookup request for Muids: %{private}@.");
    EXPECT_EQ(records[1].message,
              "Issuing favorite lines lookup request for Muids: " +
                  lookup->asked()[0].identifiers->description() + ".");
    EXPECT_EQ(records[1].redacted, "Issuing favorite lines lookup request for Muids: <private>.");
}

TEST_F(IncidentFetcher, ASuccessHoldsTheLookupsArrayItself) {
    saveLines({1});
    const auto items = NSArray::arrayOf({makeItem(1)});
    lookup->answerWith({items, nullptr});
    const auto result = fetch();
    ASSERT_TRUE(result && result->isSuccess());
    EXPECT_EQ(valueOf(result), items);
}

TEST_F(IncidentFetcher, AnErrorReachesEveryHandlerUnchangedAndIsNotRetried) {
    saveLines({1});
    const auto error = makeError();
    lookup->answerWith({nullptr, error});
    Results results;
    const auto request =
        OWTransitIncidentFetcher::init()->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(
            keeping(results));
    request->addHandler(keeping(results));
    EXPECT_TRUE(runUntil([&] { return results.size() == 2; }));
    for (const auto& result : results) {
        EXPECT_FALSE(result->isSuccess());
        EXPECT_EQ(errorOf(result), error);
    }
    EXPECT_EQ(results[0], results[1]);
    RunLoop::main().runOnce();
    EXPECT_EQ(lookup->asked().size(), 1U);
}

TEST_F(IncidentFetcher, AnErrorDecidesEvenBesideAnArray) {
    saveLines({1});
    const auto error = makeError();
    lookup->answerWith({NSArray::arrayOf({makeItem(1)}), error});
    const auto result = fetch();
    ASSERT_TRUE(result);
    EXPECT_EQ(errorOf(result), error);
}

TEST_F(IncidentFetcher, TheErrorLineShowsTheErrorAsPrivate) {
    saveLines({1});
    const auto error = makeError();
    lookup->answerWith({nullptr, error});
    (void)fetch();
    const auto records = widgetLog();
    ASSERT_EQ(records.size(), 3U);
    EXPECT_EQ(records[2].format, "Received error: %{private}@.");
    EXPECT_EQ(records[2].message, "Received error: " + error->description() + ".");
    EXPECT_EQ(records[2].redacted, "Received error: <private>.");
}

TEST_F(IncidentFetcher, TheCountOfItemsIsLoggedBeforeTheRequestEnds) {
    saveLines({1});
    lookup->answerWith({NSArray::arrayOf({makeItem(1), makeItem(2)}), nullptr});
    std::vector<std::string> logged;
    const auto request =
        OWTransitIncidentFetcher::init()->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(
            [&](const auto&) { logged = widgetMessages(); });
    ASSERT_TRUE(runUntil([&] { return request->result() != nullptr; }));
    ASSERT_EQ(logged.size(), 3U);
    EXPECT_EQ(logged[2], "Received 2 line items.");
    EXPECT_EQ(widgetLog()[2].format, "Received %lu line items.");
    EXPECT_EQ(widgetMessages(), logged);
}

TEST_F(IncidentFetcher, AllItsLinesAreDebugLinesOfTheWidgetsLog) {
    (void)fetch();
    saveLines({1});
    lookup->answerWith({NSArray::array(), nullptr});
    (void)fetch();
    lookup->answerWith({nullptr, makeError()});
    (void)fetch();
    std::vector<std::string> formats;
    for (const auto& record : widgetLog()) {
        formats.push_back(record.format);
        EXPECT_EQ(record.level, LogLevel::Debug);
        EXPECT_EQ(record.subsystem, Log::DefaultSubsystem);
    }
    EXPECT_THAT(formats,
                ElementsAre("Received %lu favorites from container.",
                            "0 Favorite lines, returning early.",
                            "Received %lu favorites from container.",
                            "Issuing favorite lines lookup request for Muids: %{private}@.",
                            "Received %lu line items.",
                            "Received %lu favorites from container.",
                            "Issuing favorite lines lookup request for Muids: %{private}@.",
                            "Received error: %{private}@."));
}

TEST_F(IncidentFetcher, CallsHandlersOnWhateverQueueTheLookupAnswers) {
    saveLines({1});
    lookup->queue = DispatchQueue::serialQueue("answers");
    for (const bool succeeds : {true, false}) {
        lookup->answerWith(
            {succeeds ? NSArray::array() : nullptr, succeeds ? nullptr : makeError()});
        std::atomic<int> onTheLookupsQueue = -1;
        (void)OWTransitIncidentFetcher::init()
            ->fetchFavoriteLinesTransitIncidentsWithCompletionHandler(
                [&](const auto&) { onTheLookupsQueue = lookup->queue->isCurrent() ? 1 : 0; });
        EXPECT_TRUE(runUntil([&] { return onTheLookupsQueue != -1; }));
        EXPECT_EQ(onTheLookupsQueue, 1);
    }
}

// Made-up incidents

TEST_F(IncidentFetcher, TheInjectionSwitchIsReadAtEveryLookup) {
    const auto random = Environment::random().overrideWith([] { return 1U; });
    saveLines({1});
    const auto items = NSArray::arrayOf({makeItem(1)});
    for (const bool inject : {false, true, false}) {
        OrvoGroup::__orvo_groupUserDefaults()->setBool_forKey(inject, injectKey);
        lookup->answerWith({items, nullptr});
        const auto value = valueOf(fetch());
        EXPECT_EQ(value == items, !inject);
        ASSERT_EQ(value->count(), 1U);
        const auto item = typed<TransitLineItem>(value)[0];
        EXPECT_EQ(item->incidents()->count(), inject ? 1U : 0U);
    }
}

TEST_F(IncidentFetcher, TheInjectionIsOverBeforeTheCountIsLogged) {
    std::vector<std::string> loggedAtLastDraw;
    const auto random = Environment::random().overrideWith([&] {
        loggedAtLastDraw = widgetMessages();
        return 1U;
    });
    OrvoGroup::__orvo_groupUserDefaults()->setBool_forKey(true, injectKey);
    saveLines({1});
    lookup->answerWith({NSArray::arrayOf({makeItem(1), makeItem(2), makeItem(3)}), nullptr});
    EXPECT_EQ(valueOf(fetch())->count(), 3U);
    auto logged = widgetMessages();
    ASSERT_EQ(logged.size(), 3U);
    EXPECT_EQ(logged.back(), "Received 3 line items.");
    logged.pop_back();
    EXPECT_EQ(loggedAtLastDraw, logged);
}

TEST_F(IncidentFetcher, NoInjectionIntoAFailure) {
    OrvoGroup::__orvo_groupUserDefaults()->setBool_forKey(true, injectKey);
    saveLines({1});
    lookup->answerWith({NSArray::arrayOf({makeItem(1)}), makeError()});
    EXPECT_FALSE(fetch()->isSuccess());
}

} // namespace
} // namespace orvo
