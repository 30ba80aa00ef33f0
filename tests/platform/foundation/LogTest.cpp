#include "platform/foundation/Log.h"

#include "platform/foundation/NSString.h"
#include "support/LogCapture.h"

#include <gtest/gtest.h>

#include <thread>

namespace orvo {
namespace {

using Levels = std::vector<std::pair<std::string, LogLevel>>;

/// Says whether anybody asked for its text.
class Watched : public virtual NSObject {
public:
    std::string description() const override {
        ++asked;
        return "watched";
    }
    mutable int asked = 0;
};

TEST(Log, IsTheSameObjectForTheSameSubsystemAndCategory) {
    const auto log = Log::findOrCreate("LogTest");
    EXPECT_EQ(Log::findOrCreate("LogTest"), log);
    EXPECT_EQ(Log::findOrCreate("LogTest", "com.zentu.Orvo"), log);
    EXPECT_NE(Log::findOrCreate("LogTest2"), log);
    EXPECT_NE(Log::findOrCreate("LogTest", "other"), log);
    EXPECT_EQ(log->category(), "LogTest");
    EXPECT_EQ(log->subsystem(), "com.zentu.Orvo");
}

TEST(Log, IsMadeOnceHoweverManyThreadsAsk) {
    std::vector<std::shared_ptr<Log>> logs(8);
    {
        std::vector<std::jthread> threads;
        for (auto& log : logs)
            threads.emplace_back([&log] { log = Log::findOrCreate("IsMadeOnce"); });
    }
    for (const auto& log : logs)
        EXPECT_EQ(log, logs.front());
}

TEST(Log, HandsTheSinkEverythingOfALine) {
    const testing::LogCapture capture;
    Log::findOrCreate("LogTest")->error("%{private}@ is %ld", std::string("secret"), 5L);
    const auto records = capture.records();
    ASSERT_EQ(records.size(), 1U);
    EXPECT_EQ(records[0].level, LogLevel::Error);
    EXPECT_EQ(records[0].subsystem, "com.zentu.Orvo");
    EXPECT_EQ(records[0].category, "LogTest");
    EXPECT_EQ(records[0].format, "%{private}@ is %ld");
    EXPECT_EQ(records[0].message, "secret is 5");
    EXPECT_EQ(records[0].redacted, "<private> is 5");
}

TEST(Log, WritesEachLevelByItsOwnName) {
    const testing::LogCapture capture;
    const auto log = Log::findOrCreate("LogTest");
    log->debug("a");
    log->info("b");
    log->write(LogLevel::Default, "c");
    log->error("d");
    log->fault("e");
    std::vector<LogLevel> levels;
    for (const auto& record : capture.records())
        levels.push_back(record.level);
    EXPECT_EQ(
        levels,
        (std::vector{
            LogLevel::Debug, LogLevel::Info, LogLevel::Default, LogLevel::Error, LogLevel::Fault}));
}

TEST(Log, TakesEveryKindOfArgument) {
    enum class Kind : signed char { Negative = -1 };
    const testing::LogCapture capture;
    const char* noText = nullptr;
    const std::shared_ptr<NSString> nil;
    const auto text = NSString::string("object");
    Log::findOrCreate("LogTest")->debug("%@ %@ %@ %@ %@ %@ %@ %@ %d %d %.1f",
                                        text,
                                        nil,
                                        noText,
                                        std::optional<std::string>(),
                                        std::optional<std::string>("optional"),
                                        "literal",
                                        std::string_view("view"),
                                        static_cast<const NSObject*>(text.get()),
                                        Kind::Negative,
                                        true,
                                        2.5F);
    EXPECT_EQ(capture.messages(),
              std::vector<std::string>{
                  "object (null) (null) (null) optional literal view object -1 1 2.5"});
}

TEST(Log, OfALevelThatIsOffAsksNobodyForText) {
    const testing::LogCapture capture;
    const auto levels = Log::levels().overrideWith(Levels{{"*", LogLevel::Error}});
    const auto watched = std::make_shared<Watched>();
    const auto log = Log::findOrCreate("LogTest");
    log->debug("%@", watched);
    log->info("%@", watched);
    EXPECT_EQ(watched->asked, 0);
    EXPECT_TRUE(capture.records().empty());
    log->error("%@", watched);
    EXPECT_GT(watched->asked, 0);
    EXPECT_EQ(capture.messages(), std::vector<std::string>{"watched"});
}

TEST(Log, FollowsAChangeOfTheLevelsAtOnce) {
    const auto log = Log::findOrCreate("LogTest");
    {
        const auto first = Log::levels().overrideWith(Levels{{"LogTest", LogLevel::Fault}});
        EXPECT_FALSE(log->isEnabled(LogLevel::Error));
        {
            const auto second = Log::levels().overrideWith(Levels{{"LogTest", LogLevel::Debug}});
            EXPECT_TRUE(log->isEnabled(LogLevel::Debug));
        }
        EXPECT_FALSE(log->isEnabled(LogLevel::Error));
        EXPECT_TRUE(log->isEnabled(LogLevel::Fault));
    }
}

TEST(Log, MayBeWrittenAndTurnedFromSeveralThreads) {
    const testing::LogCapture capture;
    constexpr int lines = 200;
    {
        const std::jthread turning([] {
            for (int i = 0; i < lines; ++i)
                const auto off = Log::levels().overrideWith(Levels{{"*", LogLevel::Fault}});
        });
        std::vector<std::jthread> writing;
        for (int t = 0; t < 3; ++t)
            writing.emplace_back([] {
                for (int i = 0; i < lines; ++i)
                    Log::findOrCreate("Threads")->fault("%d", i);
            });
    }
    EXPECT_EQ(capture.records().size(), 3U * lines);
}

} // namespace
} // namespace orvo
