#include "platform/feeds/http/Gzip.h"
#include "platform/feeds/http/HttpTransport.h"
#include "platform/feeds/http/LoadedBodies.h"
#include "platform/feeds/http/ScriptedServer.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/RunLoop.h"
#include "support/TemporaryProfile.h"
#include "support/TestClock.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <future>
#include <latch>
#include <thread>

namespace orvo {
namespace {

using testing::codeOf;
using testing::gzip;
using testing::httpReply;
using testing::load;
using testing::messageOf;
using testing::requestFor;
using testing::ScriptedServer;
using testing::ServedReply;
using testing::ServedRequest;
using testing::textOf;

using Outcome = SourceBody::Outcome;

/// Loads over real connections to a server in this process.
class NetworkTransportTest : public ::testing::Test {
protected:
    static void SetUpTestSuite() { (void)RunLoop::main(); }

    void serve(ScriptedServer::Script script) {
        server = std::make_unique<ScriptedServer>(std::move(script));
        request = requestFor(server->url());
    }
    void serve(std::string bytes) {
        serve([bytes = std::move(bytes)](const ServedRequest&) { return ServedReply{bytes}; });
    }
    std::string failure(const LoadOptions& options = {}) {
        const auto body = load(*loader, request, options);
        EXPECT_EQ(body.outcome, Outcome::Failed);
        EXPECT_EQ(body.bytes, nullptr);
        return messageOf(body).substr(request.displayLocation().size());
    }

    testing::TemporaryFolder folder;
    std::unique_ptr<ScriptedServer> server;
    std::shared_ptr<SourceLoader> loader = SourceLoader::make(folder.path());
    SourceRequest request;
};

TEST_F(NetworkTransportTest, WholeThenValidated) {
    serve([](const ServedRequest& asked) {
        return ServedReply{asked.headers.contains("if-none-match")
                               ? httpReply(304, {"ETag: \"1\""}, "")
                               : httpReply(200, {"ETag: \"1\""}, std::string("a\0b", 3))};
    });
    const auto whole = load(*loader, request);
    EXPECT_EQ(whole.outcome, Outcome::Whole);
    EXPECT_EQ(textOf(whole), std::string("a\0b", 3));
    const auto validated = load(*loader, request);
    EXPECT_EQ(validated.outcome, Outcome::Validated);
    EXPECT_EQ(textOf(validated), std::string("a\0b", 3));
    EXPECT_EQ(server->requests().at(1).headers.at("if-none-match"), "\"1\"");
}

TEST_F(NetworkTransportTest, AsksWithGetForTheWholeTarget) {
    serve(httpReply(200, {}, ""));
    request.location += "?agency=1";
    request.query = {{"key", "a b"}};
    request.headers = {{"X-Api-Key", "abcd"}};
    request.userPassword = "me:hidden";
    EXPECT_EQ(textOf(load(*loader, request)), "");
    const auto asked = server->requests().front();
    EXPECT_EQ(asked.method, "GET");
    EXPECT_EQ(asked.target, "/alerts.pb?agency=1&key=a%20b");
    EXPECT_EQ(asked.headers.at("x-api-key"), "abcd");
    EXPECT_EQ(asked.headers.at("authorization"), "Basic bWU6aGlkZGVu");
    EXPECT_EQ(asked.headers.at("accept-encoding"), "gzip");
    EXPECT_FALSE(asked.headers.contains("cookie"));
}

TEST_F(NetworkTransportTest, AProxyOfThePersonsIsAskedForTheWholeURL) {
    serve(httpReply(200, {}, "body"));
    auto proxy = server->url();
    proxy.insert(std::string_view("http://").size(), "me:hidden@");
    setenv("http_proxy", proxy.c_str(), 1);
    request = requestFor("http://city.example/alerts.pb?agency=1");
    const auto body = load(*loader, request);
    unsetenv("http_proxy");
    EXPECT_EQ(textOf(body), "body");
    const auto asked = server->requests().front();
    EXPECT_EQ(asked.target, "http://city.example/alerts.pb?agency=1");
    EXPECT_EQ(asked.headers.at("host"), "city.example");
    EXPECT_EQ(asked.headers.at("proxy-authorization"), "Basic bWU6aGlkZGVu");
}

TEST_F(NetworkTransportTest, CookiesAreNotKept) {
    serve(httpReply(200, {"Set-Cookie: a=b"}, "body"));
    (void)load(*loader, request);
    (void)load(*loader, request);
    EXPECT_FALSE(server->requests().at(1).headers.contains("cookie"));
}

TEST_F(NetworkTransportTest, ABodyWhoseEndNobodyToldIsAFailure) {
    serve("HTTP/1.1 200 OK\r\nConnection: close\r\n\r\nbody");
    EXPECT_EQ(failure(),
              ": the server does not tell how long the body is, so that nobody can know whether "
              "all of it came");
}

TEST_F(NetworkTransportTest, ABodyThatTellsItsEndItselfNeedsNoLength) {
    serve("HTTP/1.1 200 OK\r\nConnection: close\r\n\r\nbody.");
    LoadOptions options;
    options.isWhole = [](const std::shared_ptr<NSData>& bytes) {
        return bytes->stringView().ends_with('.');
    };
    EXPECT_EQ(textOf(load(*loader, request, options)), "body.");
    serve("HTTP/1.1 200 OK\r\nConnection: close\r\n\r\nbod");
    EXPECT_EQ(load(*loader, request, options).outcome, Outcome::Failed);
}

TEST_F(NetworkTransportTest, GzipTellsItsEndItself) {
    const std::string head =
        "HTTP/1.1 200 OK\r\nConnection: close\r\nContent-Encoding: gzip\r\n\r\n";
    const auto compressed = gzip("body");
    serve(head + compressed);
    EXPECT_EQ(textOf(load(*loader, request)), "body");
    serve(head + compressed.substr(0, compressed.size() - 1));
    EXPECT_EQ(failure(), ": the compressed body is not whole");
}

TEST_F(NetworkTransportTest, AChunkedBodyIsPutTogether) {
    serve("HTTP/1.1 200 OK\r\nConnection: close\r\nTransfer-Encoding: chunked\r\n\r\n"
          "2\r\nbo\r\n2\r\ndy\r\n0\r\n\r\n");
    EXPECT_EQ(textOf(load(*loader, request)), "body");
}

TEST_F(NetworkTransportTest, ABodyShorterThanItsLengthIsAFailure) {
    serve("HTTP/1.1 200 OK\r\nConnection: close\r\nContent-Length: 100\r\n\r\nonly this");
    EXPECT_EQ(failure(), ": only 9 of 100 bytes came");
}

TEST_F(NetworkTransportTest, NoBodyThoughOneIsAnnouncedIsAFailure) {
    serve("HTTP/1.1 200 OK\r\nConnection: close\r\nContent-Length: 100\r\n\r\n");
    EXPECT_EQ(failure(), ": only 0 of 100 bytes came");
}

TEST_F(NetworkTransportTest, ChunksCutShortAreAFailure) {
    serve("HTTP/1.1 200 OK\r\nConnection: close\r\nTransfer-Encoding: chunked\r\n\r\n"
          "2\r\nbo\r\n8\r\ndy");
    EXPECT_EQ(failure(), ": the body did not come whole");
}

TEST_F(NetworkTransportTest, ChunksWithoutTheLastOneAreAFailure) {
    serve("HTTP/1.1 200 OK\r\nConnection: close\r\nTransfer-Encoding: chunked\r\n\r\n"
          "2\r\nbo\r\n");
    EXPECT_EQ(failure(), ": the body did not come whole");
}

std::string inflated() {
    std::string text;
    for (int count = 0; count < 200; ++count)
        text += "alert ";
    return text;
}

TEST_F(NetworkTransportTest, GzipIsInflated) {
    serve(httpReply(200, {"Content-Encoding: gzip"}, gzip(inflated())));
    EXPECT_EQ(textOf(load(*loader, request)), inflated());
}

TEST_F(NetworkTransportTest, GzipCutShortIsAFailureWhereverItIsCut) {
    const auto whole = gzip(inflated());
    for (std::size_t length = 0; length < whole.size(); ++length) {
        // Once as the server means it, once as a broken connection leaves it.
        serve(httpReply(200, {"Content-Encoding: gzip"}, whole.substr(0, length)));
        EXPECT_EQ(codeOf(load(*loader, request)), SourceErrorCode::Incomplete) << length;
        serve("HTTP/1.1 200 OK\r\nConnection: close\r\nContent-Encoding: gzip\r\n"
              "Content-Length: " +
              std::to_string(whole.size()) + "\r\n\r\n" + whole.substr(0, length));
        EXPECT_EQ(codeOf(load(*loader, request)), SourceErrorCode::Incomplete) << length;
    }
}

TEST_F(NetworkTransportTest, WhatIsNoGzipIsAFailure) {
    serve(httpReply(200, {"Content-Encoding: gzip"}, "no gzip at all"));
    EXPECT_EQ(codeOf(load(*loader, request)), SourceErrorCode::Incomplete);
}

TEST_F(NetworkTransportTest, ACompressionThatWasNotAskedForIsAFailure) {
    serve(httpReply(200, {"Content-Encoding: br"}, "body"));
    EXPECT_EQ(failure(), ": the body came in a compression that was not asked for");
    serve(httpReply(200, {"Content-Encoding: identity"}, "body"));
    EXPECT_EQ(textOf(load(*loader, request)), "body");
}

TEST_F(NetworkTransportTest, ABodyAboveTheLimitIsAFailure) {
    LoadOptions options;
    options.maximumBytes = 1000;
    serve(httpReply(200, {}, std::string(1000, 'x')));
    EXPECT_EQ(textOf(load(*loader, request, options)).size(), 1000U);
    serve(httpReply(200, {}, std::string(1001, 'x')));
    EXPECT_EQ(failure(options), ": larger than 1000 bytes");
    serve("HTTP/1.1 200 OK\r\nConnection: close\r\n\r\n" + std::string(500'000, 'x'));
    EXPECT_EQ(failure(options), ": larger than 1000 bytes");
}

TEST_F(NetworkTransportTest, TheLimitHoldsAfterInflation) {
    LoadOptions options;
    options.maximumBytes = inflated().size();
    serve(httpReply(200, {"Content-Encoding: gzip"}, gzip(inflated())));
    EXPECT_EQ(textOf(load(*loader, request, options)), inflated());
    options.maximumBytes -= 1;
    serve(httpReply(200, {"Content-Encoding: gzip"}, gzip(inflated())));
    EXPECT_EQ(failure(options), ": larger than 1199 bytes");
}

TEST_F(NetworkTransportTest, AnErrorPageIsAFailureByItsStatus) {
    serve(httpReply(503, {"Content-Type: text/html"}, "<html>Sorry</html>"));
    EXPECT_EQ(failure(), ": 503 Service Unavailable");
    serve(httpReply(401, {"WWW-Authenticate: Basic realm=\"x\""}, "who?"));
    EXPECT_EQ(failure(), ": 401 Unauthorized");
    serve(httpReply(404, {}, ""));
    EXPECT_EQ(failure(), ": 404 Not Found");
}

TEST_F(NetworkTransportTest, RetryAfterIsHeard) {
    serve(httpReply(503, {"Retry-After: 60"}, ""));
    (void)load(*loader, request);
    EXPECT_EQ(codeOf(load(*loader, request)), SourceErrorCode::RetryLater);
    EXPECT_EQ(server->requests().size(), 1U);
}

TEST_F(NetworkTransportTest, RedirectsAreFollowed) {
    serve([](const ServedRequest& asked) {
        return ServedReply{asked.target == "/alerts.pb"
                               ? httpReply(302, {"Location: /moved?a=b"}, "elsewhere")
                               : httpReply(200, {}, asked.target)};
    });
    EXPECT_EQ(textOf(load(*loader, request)), "/moved?a=b");
}

TEST_F(NetworkTransportTest, ACircleOfRedirectsEnds) {
    serve(httpReply(301, {"Location: /alerts.pb"}, ""));
    EXPECT_EQ(codeOf(load(*loader, request)), SourceErrorCode::Redirect);
    EXPECT_EQ(server->requests().size(), 6U);
}

TEST_F(NetworkTransportTest, NobodyListeningIsUnreachable) {
    serve("");
    server.reset();
    EXPECT_EQ(failure(), ": Connection refused");
}

TEST_F(NetworkTransportTest, AServerThatHangsUpIsUnreachable) {
    serve("");
    EXPECT_EQ(failure(), ": the server hung up before it answered");
}

TEST_F(NetworkTransportTest, AServerThatSpeaksAnotherLanguageIsAFailure) {
    serve("220 mail.example ESMTP\r\n");
    EXPECT_EQ(failure(), ": what answers there is no web server");
}

TEST_F(NetworkTransportTest, ASilentServerTimesOutByTheMonotonicClock) {
    const auto clock = std::make_shared<testing::ManualMonotonicClock>();
    const auto override = Environment::monotonicClock().overrideWith(clock);
    std::promise<void> asked;
    serve([&](const ServedRequest&) {
        asked.set_value();
        return ServedReply{"", true};
    });
    testing::LoadedBodies bodies;
    (void)loader->load(request, {}, bodies.completion());
    asked.get_future().wait();
    clock->advance(16);
    const auto body = bodies.waitFor(1).front();
    EXPECT_EQ(codeOf(body), SourceErrorCode::TimedOut);
    EXPECT_EQ(messageOf(body), server->url() + ": the server said nothing for 15 seconds");
}

TEST_F(NetworkTransportTest, ASlowServerTimesOutInTheEnd) {
    const auto clock = std::make_shared<testing::ManualMonotonicClock>();
    const auto override = Environment::monotonicClock().overrideWith(clock);
    std::promise<void> asked;
    serve([&](const ServedRequest&) {
        asked.set_value();
        return ServedReply{"HTTP/1.1 200 OK\r\nContent-Length: 9\r\n\r\nbo", true};
    });
    LoadOptions options;
    options.idleTimeout = 1000;
    testing::LoadedBodies bodies;
    (void)loader->load(request, options, bodies.completion());
    asked.get_future().wait();
    clock->advance(61);
    EXPECT_EQ(messageOf(bodies.waitFor(1).front()),
              server->url() + ": the whole answer did not come in time");
}

TEST_F(NetworkTransportTest, SourcesAreLoadedSideBySide) {
    // Neither server answers before the other was asked.
    std::latch bothAsked(2);
    const auto script = [&](const ServedRequest&) {
        bothAsked.arrive_and_wait();
        return ServedReply{httpReply(200, {}, "body")};
    };
    serve(script);
    const ScriptedServer other(script);
    testing::LoadedBodies bodies;
    (void)loader->load(request, {}, bodies.completion());
    (void)loader->load(requestFor(other.url()), {}, bodies.completion());
    for (const auto& body : bodies.waitFor(2))
        EXPECT_EQ(textOf(body), "body");
}

TEST_F(NetworkTransportTest, JoiningCallersAskTheServerOnce) {
    std::promise<void> joined;
    serve([&](const ServedRequest&) {
        joined.get_future().wait();
        return ServedReply{httpReply(200, {}, "body")};
    });
    testing::LoadedBodies bodies;
    for (int count = 0; count < 20; ++count)
        (void)loader->load(request, {}, bodies.completion());
    joined.set_value();
    for (const auto& body : bodies.waitFor(20))
        EXPECT_EQ(textOf(body), "body");
    EXPECT_EQ(server->requests().size(), 1U);
}

TEST_F(NetworkTransportTest, ProgressGrowsToTheWhole) {
    const std::string whole(3'000'000, 'x');
    serve(httpReply(200, {}, whole));
    std::vector<std::uint64_t> steps;
    LoadOptions options;
    options.progress = [&](std::uint64_t soFar, std::optional<std::uint64_t> total) {
        EXPECT_EQ(total, whole.size());
        steps.push_back(soFar);
    };
    EXPECT_EQ(textOf(load(*loader, request, options)).size(), whole.size());
    ASSERT_FALSE(steps.empty());
    EXPECT_TRUE(std::ranges::is_sorted(steps));
    EXPECT_EQ(steps.back(), whole.size());
}

TEST_F(NetworkTransportTest, TheLoadersEndCancelsWhatIsUnderWay) {
    std::promise<void> asked;
    serve([&](const ServedRequest&) {
        asked.set_value();
        return ServedReply{"", true};
    });
    testing::LoadedBodies bodies;
    (void)loader->load(request, {}, bodies.completion());
    asked.get_future().wait();
    loader.reset();
    EXPECT_EQ(bodies.waitFor(1).front().error->code(), NSUserCancelledError);
}

TEST_F(NetworkTransportTest, CancellingLetsTheConnectionGo) {
    std::promise<void> asked;
    serve([&](const ServedRequest& served) {
        if (served.target != "/alerts.pb")
            return ServedReply{httpReply(200, {}, "body")};
        asked.set_value();
        return ServedReply{"HTTP/1.1 200 OK\r\nContent-Length: 9\r\n\r\nbo", true};
    });
    testing::LoadedBodies bodies;
    const auto cancelled = loader->load(request, {}, bodies.completion());
    asked.get_future().wait();
    cancelled->cancel();
    EXPECT_EQ(bodies.waitFor(1).front().error->code(), NSUserCancelledError);
    EXPECT_EQ(textOf(load(*loader, requestFor(server->url("/other")))), "body");
}

TEST_F(NetworkTransportTest, WithoutARemoteSourceNothingOfTheNetworkIsMade) {
    const auto body = load(*loader, requestFor((folder.path() / "missing").string()));
    EXPECT_EQ(codeOf(body), SourceErrorCode::Unreadable);
    // `network` names the thread.
    for (const auto& task : std::filesystem::directory_iterator("/proc/self/task")) {
        std::ifstream file(task.path() / "comm");
        std::string name;
        std::getline(file, name);
        EXPECT_NE(name, "network");
    }
}

TEST_F(NetworkTransportTest, TheProcessEndsWhileALoadIsUnderWay) {
    GTEST_FLAG_SET(death_test_style, "threadsafe");
    EXPECT_EXIT(
        {
            ScriptedServer silent([](const ServedRequest&) { return ServedReply{"", true}; });
            static auto& kept = *new std::shared_ptr(SourceLoader::make(folder.path()));
            (void)kept->load(requestFor(silent.url()), {}, [](const SourceBody&) {});
            while (silent.requests().empty())
                std::this_thread::yield();
            std::exit(7);
        },
        ::testing::ExitedWithCode(7),
        "");
}

} // namespace
} // namespace orvo
