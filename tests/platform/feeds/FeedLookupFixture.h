#pragma once

#include "platform/feeds/FeedLookup.h"
#include "platform/foundation/Text.h"
#include "support/AlertMessage.h"
#include "support/SmallSchedule.h"
#include "support/TemporaryProfile.h"
#include "support/TestClock.h"

#include <gtest/gtest.h>

#include <functional>
#include <future>
#include <map>
#include <mutex>

namespace orvo::testing {

/// A city with the feed `city` (lines 1, 2, 3) and, for who adds it, `coast` (lines A, B); sources
/// that answer what the test says.
class FeedLookupFixture : public ::testing::Test {
protected:
    static constexpr double Now = 1'750'000'000;
    static constexpr auto NowTimestamp = static_cast<std::uint64_t>(Now);
    static constexpr double Minute = 60;
    static constexpr double Hour = 3600;

    FeedLookupFixture() { addFeed("city", {"1", "2", "3"}, {"city/alerts"}); }

    void addFeed(const std::string& name,
                 const std::vector<std::string>& routes,
                 const std::vector<std::string>& sources) {
        FeedConfiguration feed;
        feed.name = name;
        for (const auto& source : sources) {
            SourceRequest request;
            request.location = source;
            feed.alerts.push_back(std::move(request));
            answerWith(source, alertMessage(NowTimestamp));
        }
        feeds.push_back(std::move(feed));
        if (!routes.empty())
            importSchedule(name, routes);
    }
    void addCoast() { addFeed("coast", {"A", "B"}, {"coast/alerts"}); }
    void importSchedule(const std::string& name, const std::vector<std::string>& routes) {
        const auto folder =
            writeSchedule(profile.path() / (name + std::to_string(++_schedules)), routes);
        const auto error =
            store->importSchedule(name, ScheduleSource::fromPath(folder), {}, nullptr);
        ASSERT_EQ(descriptionOf(error), "(null)");
    }
    static std::uint64_t city(const std::string& route) { return lineMuid("city", route); }
    static std::uint64_t coast(const std::string& route) { return lineMuid("coast", route); }

    static SourceBody body(std::shared_ptr<NSData> bytes, double fetchedAt = Now) {
        SourceBody body;
        body.bytes = std::move(bytes);
        body.fetchedAt = fetchedAt;
        return body;
    }
    void answerWith(const std::string& source, std::shared_ptr<NSData> bytes) {
        answers[source] = body(std::move(bytes));
    }
    /// The source cannot be reached; what it gave last, if anything, is `last`.
    void failWith(const std::string& source, const std::string& reason, SourceBody last = {}) {
        last.error = NSError::errorWithMessage("Test", 7, reason);
        answers[source] = std::move(last);
    }

    FeedLookup::Ground ground() {
        FeedLookup::Ground ground;
        ground.feeds = [this](std::shared_ptr<NSError>* error) {
            *error = feedsError;
            return feeds;
        };
        ground.schedules = [this](std::shared_ptr<NSError>* error) {
            *error = schedulesError;
            return schedulesError ? nullptr : store;
        };
        ground.load = [this](const SourceRequest& request,
                             const std::function<void(SourceBody)>& completion) {
            SourceBody answer;
            {
                const std::lock_guard lock(_mutex);
                asked.push_back(request.location);
                answer = answers.at(request.location);
            }
            whenAsked();
            completion(std::move(answer));
        };
        ground.lastKnownLine = [this](std::uint64_t muid) {
            const auto line = keptLines.find(muid);
            return line == keptLines.end() ? nullptr : line->second;
        };
        ground.asksForStepFree = [this] {
            return stepFree;
        };
        return ground;
    }
    FeedLookup::Answer
    await(const std::function<void(const FeedLookup&, FeedLookup::Completion)>& ask) {
        std::promise<FeedLookup::Answer> answer;
        ask(*FeedLookup::make(ground()),
            [&](const FeedLookup::Answer& given) { answer.set_value(given); });
        return answer.get_future().get();
    }
    FeedLookup::Answer lookUp(const std::vector<std::uint64_t>& muids) {
        return await([&](const FeedLookup& lookup, FeedLookup::Completion completion) {
            lookup.lookUpLines(muids, std::move(completion));
        });
    }
    FeedLookup::Answer lookUpFeeds(const std::optional<std::vector<std::string>>& names = {}) {
        return await([&](const FeedLookup& lookup, FeedLookup::Completion completion) {
            lookup.lookUpFeeds(names, std::move(completion));
        });
    }

    static std::vector<std::shared_ptr<FeedTransitIncident>>
    incidents(const std::shared_ptr<FeedTransitLineItem>& item) {
        return typed<FeedTransitIncident>(item->incidents());
    }
    /// `clear`, `unknown` when it says so alone, else the titles.
    static std::string status(const std::shared_ptr<FeedTransitLineItem>& item) {
        const auto all = incidents(item);
        if (all.empty())
            return "clear";
        if (all.size() == 1 && all.front()->details().isUnknown)
            return "unknown";
        std::string titles;
        for (const auto& incident : all) {
            titles += titles.empty() ? "" : ", ";
            titles += incident->details().isUnknown ? "unknown" : incident->title().value_or("");
        }
        return titles;
    }
    static std::vector<std::string> statuses(const FeedLookup::Answer& answer) {
        EXPECT_EQ(descriptionOf(answer.error), "(null)");
        std::vector<std::string> statuses;
        for (const auto& item : answer.items)
            statuses.push_back(status(item));
        return statuses;
    }

    TemporaryProfile profile;
    StoppedClock clock{Now};
    EnvironmentSlot<std::string>::Override language = Text::locale().overrideWith("en");
    std::shared_ptr<ScheduleStore> store =
        ScheduleStore::open(ScheduleStore::defaultPath(), nullptr);
    std::vector<FeedConfiguration> feeds;
    std::shared_ptr<NSError> feedsError;
    std::shared_ptr<NSError> schedulesError;
    std::map<std::string, SourceBody> answers;
    std::vector<std::string> asked;
    std::function<void()> whenAsked = [] {
    };
    std::map<std::uint64_t, std::shared_ptr<FeedTransitLine>> keptLines;
    bool stepFree = false;

private:
    std::mutex _mutex;
    int _schedules = 0;
};

} // namespace orvo::testing
