#include "platform/mapuikit/FeedLookupService.h"

#include "platform/feeds/FeedLookupFixture.h"
#include "platform/feeds/ScheduleUpdater.h"
#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/RunLoop.h"

#include <gmock/gmock.h>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

class FeedLookupServiceTest : public testing::FeedLookupFixture {
protected:
    struct Answer {
        int calls = 0;
        bool onMainThread = false;
        std::shared_ptr<NSArray> items;
        std::shared_ptr<NSError> error;
    };
    static std::shared_ptr<NSArray> identifiers(const std::vector<std::uint64_t>& muids) {
        NSArray::Elements elements;
        for (const auto muid : muids)
            elements.push_back(MapItemIdentifier::identifierWithMuid(muid));
        return NSArray::arrayWithObjects(std::move(elements));
    }
    std::shared_ptr<FeedLookupService> service(std::shared_ptr<ScheduleUpdater> updater = nullptr) {
        return FeedLookupService::initWithLookup_updater(FeedLookup::make(ground()),
                                                         std::move(updater));
    }
    LineItemTicket::Handler handler() {
        return
            [this](const std::shared_ptr<NSArray>& items, const std::shared_ptr<NSError>& error) {
                events.emplace_back("answer");
                answer.calls += 1;
                answer.onMainThread = RunLoop::isMainThread();
                answer.items = items;
                answer.error = error;
            };
    }
    Answer submit(const std::shared_ptr<NSArray>& asking) {
        answer = {};
        service()
            ->ticketForTransitLines_traits(asking, nullptr)
            ->submitWithHandler_networkActivity(handler(), nullptr);
        EXPECT_EQ(answer.calls, 0) << "answered inside the call";
        EXPECT_TRUE(RunLoop::main().runUntil([&] { return answer.calls > 0; }, 10));
        return answer;
    }

    Answer answer;
    std::vector<std::string> events;
    RunLoop& loop = RunLoop::main();
};

TEST_F(FeedLookupServiceTest, AnswersOnceOnTheMainThreadAndNeverInsideTheCall) {
    const auto given = submit(identifiers({city("2"), city("1")}));
    EXPECT_TRUE(given.onMainThread);
    EXPECT_EQ(given.error, nullptr);
    std::vector<std::uint64_t> muids;
    for (const auto& item : typed<TransitLineItem>(given.items))
        muids.push_back(item->muid());
    EXPECT_THAT(muids, ElementsAre(city("2"), city("1")));
    loop.runOnce();
    EXPECT_EQ(answer.calls, 1);
}

TEST_F(FeedLookupServiceTest, AnErrorComesWithoutItems) {
    failWith("city/alerts", "no answer");
    const auto given = submit(identifiers({city("1")}));
    EXPECT_NE(given.error, nullptr);
    EXPECT_EQ(given.items, nullptr);
}

TEST_F(FeedLookupServiceTest, NoIdentifiersAreAnEmptyAnswer) {
    for (const auto& none : {NSArray::array(), std::shared_ptr<NSArray>()}) {
        const auto given = submit(none);
        EXPECT_EQ(given.error, nullptr);
        ASSERT_NE(given.items, nullptr);
        EXPECT_EQ(given.items->count(), 0U);
    }
    EXPECT_THAT(asked, IsEmpty());
}

TEST_F(FeedLookupServiceTest, NothingIsAskedBeforeTheTicketIsSubmitted) {
    const auto ticket = service()->ticketForTransitLines_traits(identifiers({city("1")}), nullptr);
    loop.runOnce();
    EXPECT_THAT(asked, IsEmpty());
}

TEST_F(FeedLookupServiceTest, TellsOfNetworkActivityAroundTheLookup) {
    service()
        ->ticketForTransitLines_traits(identifiers({city("1")}), nullptr)
        ->submitWithHandler_networkActivity(handler(), [this](bool active) {
            EXPECT_TRUE(RunLoop::isMainThread());
            events.emplace_back(active ? "active" : "idle");
        });
    EXPECT_TRUE(loop.runUntil([&] { return answer.calls > 0; }, 10));
    EXPECT_THAT(events, ElementsAre("active", "idle", "answer"));
}

TEST_F(FeedLookupServiceTest, ATicketIsSubmittedOnce) {
    const auto ticket = service()->ticketForTransitLines_traits(identifiers({city("1")}), nullptr);
    ticket->submitWithHandler_networkActivity(handler(), nullptr);
    EXPECT_THROW(ticket->submitWithHandler_networkActivity(handler(), nullptr),
                 NSInvalidArgumentException);
    EXPECT_TRUE(loop.runUntil([&] { return answer.calls > 0; }, 10));
    EXPECT_EQ(answer.calls, 1);
}

TEST_F(FeedLookupServiceTest, AnIdentifierOfAnotherClassIsAProgrammingError) {
    EXPECT_THROW((void)service()->ticketForTransitLines_traits(
                     NSArray::arrayOf<NSString>({NSString::string("1")}), nullptr),
                 NSInvalidArgumentException);
}

TEST_F(FeedLookupServiceTest, NeedsALookup) {
    EXPECT_THROW((void)FeedLookupService::initWithLookup_updater(nullptr, nullptr),
                 NSInvalidArgumentException);
}

TEST_F(FeedLookupServiceTest, SchedulesAreCheckedAfterTheAnswer) {
    ScheduleUpdater::Ground updating;
    std::promise<int> callsAtCheck;
    updating.feeds = [&] {
        callsAtCheck.set_value(answer.calls);
        return std::vector<FeedConfiguration>();
    };
    service(ScheduleUpdater::make(updating))
        ->ticketForTransitLines_traits(identifiers({city("1")}), nullptr)
        ->submitWithHandler_networkActivity(handler(), nullptr);
    EXPECT_TRUE(loop.runUntil([&] { return answer.calls > 0; }, 10));
    EXPECT_EQ(callsAtCheck.get_future().get(), 1);
}

} // namespace
} // namespace orvo
