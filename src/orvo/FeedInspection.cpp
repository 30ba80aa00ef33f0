#include "orvo/FeedInspection.h"

#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/RunLoop.h"

namespace orvo::FeedInspection {

FeedLookup::Answer of(const std::vector<FeedConfiguration>& feeds, CommandContext& context) {
    (void)RunLoop::main();
    FeedLookup::Answer answer;
    auto schedules = context.schedules(answer.error);
    if (!schedules)
        return answer;
    constexpr bool Insists = true; // a person asked for just this
    auto ground = FeedLookup::profileGround(Insists);
    ground.feeds = [feeds](std::shared_ptr<NSError>*) {
        return feeds;
    };
    ground.schedules = [schedules](std::shared_ptr<NSError>*) {
        return schedules;
    };
    bool ended = false;
    context.terminal().progress("Asking for alerts …");
    FeedLookup::make(std::move(ground))
        ->lookUpFeeds(std::nullopt, [&](const FeedLookup::Answer& given) {
            DispatchQueue::mainQueue()->async([&, given] {
                answer = given;
                ended = true;
            });
        });
    CommandContext::waitUntil([&] { return ended; });
    context.terminal().endProgress();
    return answer;
}

} // namespace orvo::FeedInspection
