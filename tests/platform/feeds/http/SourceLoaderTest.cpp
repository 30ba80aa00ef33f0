#include "platform/feeds/http/SourceLoader.h"

#include "platform/feeds/http/FakeTransport.h"
#include "platform/feeds/http/LoadedBodies.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/Environment.h"
#include "support/TemporaryProfile.h"
#include "support/TestClock.h"

#include <gtest/gtest.h>

#include <fstream>

namespace orvo {
namespace {

using Outcome = SourceBody::Outcome;
using testing::codeOf;
using testing::load;
using testing::messageOf;
using testing::requestFor;
using testing::textOf;

constexpr double Start = 1750000000;
constexpr double Day = 24 * 3600;

std::string headerOf(const HttpExchange& exchange, const std::string& name) {
    for (const auto& [key, value] : exchange.headers)
        if (key == name)
            return value;
    return "(none)";
}

/// The loader's rules, on a network of our own.
class SourceLoaderTest : public ::testing::Test {
protected:
    void loadOnce(const std::string& tag = "\"1\"") {
        network->answer(200, {{"etag", tag}}, "first");
        ASSERT_EQ(load(*loader, request).outcome, Outcome::Whole);
    }
    HttpExchange lastAsked() const { return network->asked().back(); }
    void write(const std::filesystem::path& path, const std::string& text) {
        std::ofstream(path, std::ios::binary) << text;
    }

    testing::TemporaryFolder folder;
    testing::StoppedClock clock{Start};
    std::shared_ptr<testing::ManualMonotonicClock> monotonic =
        std::make_shared<testing::ManualMonotonicClock>();
    EnvironmentSlot<std::shared_ptr<MonotonicClock>>::Override monotonicOverride =
        Environment::monotonicClock().overrideWith(monotonic);
    std::shared_ptr<testing::FakeTransport> network = std::make_shared<testing::FakeTransport>();
    std::shared_ptr<SourceLoader> loader = SourceLoader::make(folder.path() / "cache", network);
    SourceRequest request = requestFor("https://example.org/alerts.pb");
};

TEST_F(SourceLoaderTest, AnswersOnAWorkerQueueAndNeverInsideTheCall) {
    network->answer(200, {}, "body");
    std::mutex mutex;
    std::unique_lock held(mutex);
    bool onWorker = false;
    testing::LoadedBodies bodies;
    (void)loader->load(request, {}, [&, tell = bodies.completion()](SourceBody body) {
        {
            // Stuck for ever if it ran inside the call.
            const std::lock_guard lock(mutex);
            onWorker = DispatchQueue::globalQueue()->isCurrent();
        }
        tell(std::move(body));
    });
    held.unlock();
    bodies.waitFor(1);
    EXPECT_TRUE(onWorker);
}

TEST_F(SourceLoaderTest, TheFirstRequestIsUnconditional) {
    loadOnce();
    EXPECT_EQ(headerOf(lastAsked(), "If-None-Match"), "(none)");
    EXPECT_EQ(headerOf(lastAsked(), "If-Modified-Since"), "(none)");
}

TEST_F(SourceLoaderTest, ValidatedBodyKeepsItsBytesAndRenewsItsProof) {
    loadOnce();
    clock->advance(60);
    network->answer(304);
    const auto body = load(*loader, request);
    EXPECT_EQ(headerOf(lastAsked(), "If-None-Match"), "\"1\"");
    EXPECT_EQ(body.outcome, Outcome::Validated);
    EXPECT_EQ(textOf(body), "first");
    EXPECT_EQ(body.fetchedAt, Start + 60);
    EXPECT_EQ(body.receivedAt, Start);
    EXPECT_EQ(body.error, nullptr);
}

TEST_F(SourceLoaderTest, LastModifiedIsSentBackAsItCame) {
    network->answer(200, {{"last-modified", "whenever it was"}}, "first");
    (void)load(*loader, request);
    network->answer(304);
    EXPECT_EQ(load(*loader, request).outcome, Outcome::Validated);
    EXPECT_EQ(headerOf(lastAsked(), "If-Modified-Since"), "whenever it was");
}

TEST_F(SourceLoaderTest, AnotherLoaderContinuesFromTheDisk) {
    loadOnce();
    loader = SourceLoader::make(folder.path() / "cache", network);
    network->answer(304);
    EXPECT_EQ(textOf(load(*loader, request)), "first");
    EXPECT_EQ(headerOf(lastAsked(), "If-None-Match"), "\"1\"");
}

TEST_F(SourceLoaderTest, OtherCredentialsDoNotValidateTheBody) {
    loadOnce();
    request.headers = {{"X-Api-Key", "another"}};
    network->answer(200, {}, "second");
    EXPECT_EQ(textOf(load(*loader, request)), "second");
    EXPECT_EQ(headerOf(lastAsked(), "If-None-Match"), "(none)");
}

TEST_F(SourceLoaderTest, AfterTwentyValidationsTheBodyIsAskedForWhole) {
    loadOnce();
    for (int count = 0; count < 20; ++count) {
        network->answer(304);
        ASSERT_EQ(load(*loader, request).outcome, Outcome::Validated) << count;
    }
    network->answer(200, {{"etag", "\"2\""}}, "second");
    EXPECT_EQ(textOf(load(*loader, request)), "second");
    EXPECT_EQ(headerOf(lastAsked(), "If-None-Match"), "(none)");
    network->answer(304);
    EXPECT_EQ(load(*loader, request).outcome, Outcome::Validated);
}

TEST_F(SourceLoaderTest, ABodyOlderThanADayIsAskedForWhole) {
    loadOnce();
    clock->advance(Day);
    network->answer(304);
    EXPECT_EQ(load(*loader, request).outcome, Outcome::Validated);
    clock->advance(1);
    network->answer(200, {}, "second");
    EXPECT_EQ(textOf(load(*loader, request)), "second");
    EXPECT_EQ(headerOf(lastAsked(), "If-None-Match"), "(none)");
}

TEST_F(SourceLoaderTest, AScheduleIsValidatedForAMonth) {
    loadOnce();
    clock->advance(30 * Day);
    network->answer(304);
    EXPECT_EQ(load(*loader, request, LoadOptions::forSchedule()).outcome, Outcome::Validated);
}

TEST_F(SourceLoaderTest, ABodyFromTheFutureIsAskedForWhole) {
    loadOnce();
    clock->advance(-Day);
    network->answer(200, {}, "second");
    EXPECT_EQ(textOf(load(*loader, request)), "second");
    EXPECT_EQ(headerOf(lastAsked(), "If-None-Match"), "(none)");
}

TEST_F(SourceLoaderTest, UnconditionalIsUnconditional) {
    loadOnce();
    LoadOptions options;
    options.unconditional = true;
    network->answer(200, {}, "second");
    EXPECT_EQ(textOf(load(*loader, request, options)), "second");
    EXPECT_EQ(headerOf(lastAsked(), "If-None-Match"), "(none)");
}

TEST_F(SourceLoaderTest, NotModifiedWithoutBeingAskedIsAFailure) {
    network->answer(304);
    const auto body = load(*loader, request);
    EXPECT_EQ(body.outcome, Outcome::Failed);
    EXPECT_EQ(messageOf(body), "https://example.org/alerts.pb: 304 Not Modified");
}

TEST_F(SourceLoaderTest, AValidatedButDamagedBodyIsAskedForWhole) {
    loadOnce();
    for (const auto& file : std::filesystem::directory_iterator(folder.path() / "cache/bodies"))
        if (file.path().extension() == ".body")
            write(file.path(), "fxrst");
    network->answer(304);
    network->answer(200, {}, "second");
    const auto body = load(*loader, request);
    EXPECT_EQ(body.outcome, Outcome::Whole);
    EXPECT_EQ(textOf(body), "second");
    EXPECT_EQ(headerOf(lastAsked(), "If-None-Match"), "(none)");
}

TEST_F(SourceLoaderTest, AFailureGivesTheLastGoodBodyBesideItsError) {
    loadOnce();
    clock->advance(60);
    network->answer(503, {}, "<html>");
    const auto body = load(*loader, request);
    EXPECT_EQ(body.outcome, Outcome::Failed);
    EXPECT_EQ(codeOf(body), SourceErrorCode::Status);
    EXPECT_EQ(messageOf(body), "https://example.org/alerts.pb: 503 Service Unavailable");
    EXPECT_EQ(textOf(body), "first");
    EXPECT_EQ(body.fetchedAt, Start);
    EXPECT_EQ(textOf(loader->lastGoodBody(request)), "first");
}

TEST_F(SourceLoaderTest, WithoutAnEarlierBodyAFailureHasNone) {
    network->answer(404);
    const auto body = load(*loader, request);
    EXPECT_EQ(body.bytes, nullptr);
    EXPECT_EQ(body.fetchedAt, 0);
    EXPECT_EQ(loader->lastGoodBody(request).bytes, nullptr);
}

TEST_F(SourceLoaderTest, OnlyTwoHundredIsAWholeBody) {
    for (const int status : {201, 204, 206, 400, 401, 403, 500}) {
        network->answer(status, {}, "body");
        EXPECT_EQ(codeOf(load(*loader, request)), SourceErrorCode::Status) << status;
    }
}

TEST_F(SourceLoaderTest, ARefusedBodyLeavesTheLastGoodOne) {
    loadOnce();
    LoadOptions options;
    options.check = [](const NSData& bytes) {
        return bytes.stringView() == "<html>" ? NSError::errorWithMessage("Test", 1, "HTML")
                                              : nullptr;
    };
    network->answer(200, {{"etag", "\"html\""}}, "<html>");
    const auto refused = load(*loader, request, options);
    EXPECT_EQ(refused.outcome, Outcome::Failed);
    EXPECT_EQ(messageOf(refused), "HTML");
    EXPECT_EQ(textOf(refused), "first");
    network->answer(304);
    EXPECT_EQ(textOf(load(*loader, request, options)), "first");
    EXPECT_EQ(headerOf(lastAsked(), "If-None-Match"), "\"1\"");
}

TEST_F(SourceLoaderTest, ABodyWhoseEndNobodyToldLeavesTheLastGoodOne) {
    loadOnce();
    HttpAnswer answer;
    answer.status = 200;
    answer.headers = {{"etag", "\"2\""}};
    answer.body = NSData::dataWithString("second");
    answer.isEndTold = false;
    network->answer(answer);
    const auto refused = load(*loader, request);
    EXPECT_EQ(refused.outcome, Outcome::Failed);
    EXPECT_EQ(codeOf(refused), SourceErrorCode::Incomplete);
    EXPECT_TRUE(messageOf(refused).starts_with("https://example.org/alerts.pb: "));
    EXPECT_EQ(textOf(refused), "first");
}

TEST_F(SourceLoaderTest, ARequestInsideThePauseFailsAtOnce) {
    loadOnce();
    network->answer(429, {{"retry-after", "120"}});
    (void)load(*loader, request);
    const auto asked = network->asked().size();
    monotonic->advance(60.5);
    const auto body = load(*loader, request);
    EXPECT_EQ(codeOf(body), SourceErrorCode::RetryLater);
    EXPECT_EQ(messageOf(body),
              "https://example.org/alerts.pb: the server asked to be left alone for 60 seconds "
              "more (429 Too Many Requests)");
    EXPECT_EQ(textOf(body), "first");
    EXPECT_EQ(network->asked().size(), asked);
}

TEST_F(SourceLoaderTest, AfterThePauseTheServerIsAskedAgain) {
    network->answer(503,
                    {{"retry-after", "Sun, 06 Nov 1994 08:51:37 GMT"},
                     {"date", "Sun, 06 Nov 1994 08:49:37 GMT"}});
    (void)load(*loader, request);
    monotonic->advance(119);
    EXPECT_EQ(codeOf(load(*loader, request)), SourceErrorCode::RetryLater);
    monotonic->advance(1);
    network->answer(200, {}, "body");
    EXPECT_EQ(textOf(load(*loader, request)), "body");
}

TEST_F(SourceLoaderTest, AProgramThatIsStartedInThePauseAsksNobody) {
    network->answer(503, {{"retry-after", "3600"}});
    (void)load(*loader, request);
    const auto asked = network->asked().size();
    loader = SourceLoader::make(folder.path() / "cache", network);
    EXPECT_EQ(codeOf(load(*loader, request)), SourceErrorCode::RetryLater);
    EXPECT_EQ(network->asked().size(), asked);
}

TEST_F(SourceLoaderTest, APersonWhoWantsToKnowIsAnsweredInThePause) {
    network->answer(503, {{"retry-after", "3600"}});
    (void)load(*loader, request);
    LoadOptions options;
    options.inPause = true;
    network->answer(503, {{"retry-after", "3600"}});
    EXPECT_EQ(codeOf(load(*loader, request, options)), SourceErrorCode::Status);
    EXPECT_EQ(network->asked().size(), 2U);
    network->answer(200, {}, "body");
    EXPECT_EQ(textOf(load(*loader, request, options)), "body");
    network->answer(200, {}, "and again");
    EXPECT_EQ(textOf(load(*loader, request)), "and again") << "the pause is over";
}

TEST_F(SourceLoaderTest, ThePauseIsThatRequestsOwn) {
    network->answer(503, {{"retry-after", "120"}});
    (void)load(*loader, request);
    network->answer(200, {}, "body");
    EXPECT_EQ(textOf(load(*loader, requestFor("https://example.org/other.pb"))), "body");
}

TEST_F(SourceLoaderTest, JoiningCallersShareOneRequest) {
    testing::LoadedBodies bodies;
    for (int count = 0; count < 50; ++count)
        (void)loader->load(request, {}, bodies.completion());
    network->answer(200, {}, "body");
    for (const auto& body : bodies.waitFor(50))
        EXPECT_EQ(textOf(body), "body");
    EXPECT_EQ(network->asked().size(), 1U);
    network->answer(200, {}, "again");
    EXPECT_EQ(textOf(load(*loader, request)), "again");
}

TEST_F(SourceLoaderTest, CallersJoinFromManyThreads) {
    testing::LoadedBodies bodies;
    std::vector<std::thread> threads;
    threads.reserve(8);
    for (int index = 0; index < 8; ++index)
        threads.emplace_back([&] {
            for (int count = 0; count < 50; ++count)
                (void)loader->load(request, {}, bodies.completion());
        });
    for (int count = 0; count < 400; ++count)
        network->answer(200, {}, "body");
    for (auto& thread : threads)
        thread.join();
    EXPECT_EQ(bodies.waitFor(400).size(), 400U);
    EXPECT_LE(network->asked().size(), 400U);
}

TEST_F(SourceLoaderTest, ACancelledCallerLeavesTheOthers) {
    testing::LoadedBodies cancelled;
    testing::LoadedBodies others;
    const auto first = loader->load(request, {}, cancelled.completion());
    (void)loader->load(request, {}, others.completion());
    first->cancel();
    first->cancel();
    const auto body = cancelled.waitFor(1).front();
    EXPECT_EQ(body.error->domain(), NSCocoaErrorDomain);
    EXPECT_EQ(body.error->code(), NSUserCancelledError);
    network->answer(200, {}, "body");
    EXPECT_EQ(textOf(others.waitFor(1).front()), "body");
    EXPECT_EQ(cancelled.waitFor(1).size(), 1U);
}

TEST_F(SourceLoaderTest, TheLastCallersCancellationEndsTheExchange) {
    testing::LoadedBodies bodies;
    const auto first = loader->load(request, {}, bodies.completion());
    network->waitUntilAsked(1);
    first->cancel();
    EXPECT_EQ(bodies.waitFor(1).front().error->code(), NSUserCancelledError);
    network->answer(200, {}, "body");
    EXPECT_EQ(textOf(load(*loader, request)), "body");
    EXPECT_EQ(network->asked().size(), 2U);
    EXPECT_EQ(network->cancelled(), 1U);
}

TEST_F(SourceLoaderTest, TheLoadersEndCancelsWhatIsUnderWay) {
    testing::LoadedBodies bodies;
    (void)loader->load(request, {}, bodies.completion());
    (void)loader->load(requestFor("https://example.org/other"), {}, bodies.completion());
    network->waitUntilAsked(2);
    loader.reset();
    for (const auto& body : bodies.waitFor(2))
        EXPECT_EQ(body.error->code(), NSUserCancelledError);
    EXPECT_EQ(network->cancelled(), 2U);
}

TEST_F(SourceLoaderTest, ACallerMayDropTheLoaderInItsCompletion) {
    network->answer(200, {}, "body");
    testing::LoadedBodies bodies;
    auto* raw = loader.get();
    (void)raw->load(request, {}, [&, tell = bodies.completion()](SourceBody body) {
        loader.reset();
        tell(std::move(body));
    });
    EXPECT_EQ(textOf(bodies.waitFor(1).front()), "body");
}

TEST_F(SourceLoaderTest, AnInvalidRequestIsNotAsked) {
    const auto body = load(*loader, requestFor("https://"));
    EXPECT_EQ(codeOf(body), SourceErrorCode::InvalidRequest);
    EXPECT_TRUE(network->asked().empty());
}

TEST_F(SourceLoaderTest, KeptInMemoryNothingReachesTheDisk) {
    const auto inMemory = Environment::keepsWritesInMemory().overrideWith(true);
    loadOnce();
    network->answer(304);
    EXPECT_EQ(load(*loader, request).outcome, Outcome::Validated);
    EXPECT_FALSE(std::filesystem::exists(folder.path() / "cache"));
}

TEST_F(SourceLoaderTest, ALocalFileIsReadWholeEachTime) {
    const auto path = folder.path() / "alerts.pb";
    write(path, "local");
    const auto body = load(*loader, requestFor(path.string()));
    EXPECT_EQ(body.outcome, Outcome::Whole);
    EXPECT_EQ(textOf(body), "local");
    EXPECT_EQ(body.fetchedAt, Start);
    write(path, "changed");
    EXPECT_EQ(textOf(load(*loader, requestFor("file://" + path.string()))), "changed");
}

TEST_F(SourceLoaderTest, AMissingFileIsNamedWithTheReason) {
    const auto path = (folder.path() / "missing.pb").string();
    const auto body = load(*loader, requestFor(path));
    EXPECT_EQ(codeOf(body), SourceErrorCode::Unreadable);
    EXPECT_EQ(messageOf(body), path + ": there is no such file");
    EXPECT_EQ(body.bytes, nullptr);
}

TEST_F(SourceLoaderTest, AFolderIsNoFile) {
    const auto path = folder.path().string();
    EXPECT_EQ(messageOf(load(*loader, requestFor(path))), path + ": Is a directory");
}

TEST_F(SourceLoaderTest, AFileAboveTheLimitIsRefused) {
    const auto path = folder.path() / "alerts.pb";
    write(path, "12345");
    LoadOptions options;
    options.maximumBytes = 5;
    EXPECT_EQ(textOf(load(*loader, requestFor(path.string()), options)), "12345");
    options.maximumBytes = 4;
    const auto body = load(*loader, requestFor(path.string()), options);
    EXPECT_EQ(codeOf(body), SourceErrorCode::TooLarge);
    EXPECT_EQ(messageOf(body), path.string() + ": larger than 4 bytes");
}

} // namespace
} // namespace orvo
