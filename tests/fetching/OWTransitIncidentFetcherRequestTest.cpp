#include "fetching/OWTransitIncidentFetcher.h"
#include "fetching/_OWTransitIncidentFetcherRequest.h"
#include "platform/foundation/NSArray.h"

#include <gtest/gtest.h>

#include <atomic>
#include <functional>
#include <latch>
#include <memory>
#include <string>
#include <thread>
#include <type_traits>
#include <utility>
#include <vector>

namespace orvo {
namespace {

using Request = _OWTransitIncidentFetcherRequest;
using CompletionHandler = OWTransitIncidentFetcherRequest::CompletionHandler;

std::shared_ptr<Result> makeResult() {
    return Result::resultWithValue(NSArray::array());
}

/// A handler that writes its name down.
CompletionHandler noting(std::string& notes, const char* name) {
    return [&notes, name](const auto&) {
        notes += name;
    };
}

TEST(IncidentFetcherRequest, ShowsCallersOnlyTheProtocol) {
    using Answer =
        std::invoke_result_t<decltype(&OWTransitIncidentFetcher::
                                          fetchFavoriteLinesTransitIncidentsWithCompletionHandler),
                             OWTransitIncidentFetcher,
                             CompletionHandler>;
    EXPECT_TRUE((std::is_same_v<Answer, std::shared_ptr<OWTransitIncidentFetcherRequest>>));
    EXPECT_TRUE(std::is_abstract_v<OWTransitIncidentFetcherRequest>);
}

TEST(IncidentFetcherRequest, IsPendingWithTheCreatorsHandlerAtFirst) {
    const auto request = Request::initWithCompletionHandler([](const auto&) {});
    EXPECT_EQ(request->result(), nullptr);
    EXPECT_EQ(request->handlers().size(), 1U);
}

TEST(IncidentFetcherRequest, WithoutAHandlerStartsEmptyAndEndsNormally) {
    const auto request = Request::initWithCompletionHandler(nullptr);
    EXPECT_TRUE(request->handlers().empty());
    const auto result = makeResult();
    request->setResultAndInvokeCompletionHandlers(result);
    EXPECT_EQ(request->result(), result);
}

TEST(IncidentFetcherRequest, CallsHandlersInTheOrderAddedTheCreatorsFirst) {
    std::string called;
    const auto request = Request::initWithCompletionHandler(noting(called, "a"));
    request->addHandler(noting(called, "b"));
    request->addHandler(noting(called, "c"));
    EXPECT_EQ(called, "");
    request->setResultAndInvokeCompletionHandlers(makeResult());
    EXPECT_EQ(called, "abc");
}

TEST(IncidentFetcherRequest, AHandlerAddedTwiceIsCalledTwice) {
    std::string called;
    const auto handler = noting(called, "a");
    const auto request = Request::initWithCompletionHandler(handler);
    request->addHandler(handler);
    EXPECT_EQ(request->handlers().size(), 2U);
    request->setResultAndInvokeCompletionHandlers(makeResult());
    EXPECT_EQ(called, "aa");
}

TEST(IncidentFetcherRequest, ANilHandlerIsIgnored) {
    const auto request = Request::initWithCompletionHandler([](const auto&) {});
    request->addHandler(nullptr);
    EXPECT_EQ(request->handlers().size(), 1U);
    request->setResultAndInvokeCompletionHandlers(makeResult());
    request->addHandler(nullptr);
    EXPECT_EQ(request->handlers().size(), 1U);
}

TEST(IncidentFetcherRequest, HandlersAreACopy) {
    std::string called;
    const auto request = Request::initWithCompletionHandler(noting(called, "a"));
    auto copy = request->handlers();
    copy.clear();
    EXPECT_EQ(request->handlers().size(), 1U);
    request->setResultAndInvokeCompletionHandlers(makeResult());
    EXPECT_EQ(called, "a");
}

TEST(IncidentFetcherRequest, HandlersStayInTheListAfterTheEnd) {
    const auto request = Request::initWithCompletionHandler([](const auto&) {});
    request->addHandler([](const auto&) {});
    request->setResultAndInvokeCompletionHandlers(makeResult());
    EXPECT_EQ(request->handlers().size(), 2U);
}

TEST(IncidentFetcherRequest, AHandlerAddedAfterTheEndIsCalledAtOnceAndNotKept) {
    const auto request = Request::initWithCompletionHandler([](const auto&) {});
    request->setResultAndInvokeCompletionHandlers(makeResult());
    std::thread::id adder;
    std::thread::id called;
    std::thread([&] {
        adder = std::this_thread::get_id();
        request->addHandler([&](const auto&) { called = std::this_thread::get_id(); });
        EXPECT_EQ(called, adder);
    }).join();
    EXPECT_EQ(request->handlers().size(), 1U);
}

TEST(IncidentFetcherRequest, AllHandlersGetTheSameResultObject) {
    std::vector<std::shared_ptr<Result>> given;
    const auto keep = [&](const std::shared_ptr<Result>& result) {
        given.push_back(result);
    };
    const auto request = Request::initWithCompletionHandler(keep);
    request->addHandler(keep);
    const auto result = makeResult();
    request->setResultAndInvokeCompletionHandlers(result);
    request->addHandler(keep);
    EXPECT_EQ(given, (std::vector<std::shared_ptr<Result>>{result, result, result}));
    EXPECT_EQ(request->result(), result);
}

TEST(IncidentFetcherRequest, TheResultIsStoredBeforeHandlersAreCalled) {
    std::shared_ptr<Result> seen;
    const auto request = Request::initWithCompletionHandler(nullptr);
    request->addHandler([&](const auto&) { seen = request->result(); });
    const auto result = makeResult();
    request->setResultAndInvokeCompletionHandlers(result);
    EXPECT_EQ(seen, result);
}

TEST(IncidentFetcherRequest, AHandlerMayAddAnotherWhichIsCalledAtOnce) {
    std::string called;
    const auto request = Request::initWithCompletionHandler(nullptr);
    request->addHandler([&](const auto&) {
        called += "a";
        request->addHandler(noting(called, "b"));
    });
    request->addHandler(noting(called, "c"));
    request->setResultAndInvokeCompletionHandlers(makeResult());
    EXPECT_EQ(called, "abc");
    EXPECT_EQ(request->handlers().size(), 2U);
}

TEST(IncidentFetcherRequest, HandlersAreCalledWithoutTheLock) {
    std::string called;
    const auto request = Request::initWithCompletionHandler(nullptr);
    request->addHandler([&](const auto&) {
        // Another thread gets through every door while this handler runs.
        std::thread([&] {
            EXPECT_EQ(request->handlers().size(), 1U);
            EXPECT_NE(request->result(), nullptr);
            request->addHandler(noting(called, "b"));
        }).join();
        called += "a";
    });
    request->setResultAndInvokeCompletionHandlers(makeResult());
    EXPECT_EQ(called, "ba");
}

TEST(IncidentFetcherRequest, AHandlerMayLetGoOfTheLastReference) {
    std::string called;
    auto request = Request::initWithCompletionHandler(nullptr);
    const std::weak_ptr<Request> watch = request;
    request->addHandler([&](const auto&) {
        request.reset();
        EXPECT_TRUE(watch.expired());
    });
    request->addHandler(noting(called, "a"));
    request->setResultAndInvokeCompletionHandlers(makeResult());
    EXPECT_EQ(called, "a");
}

/// A handler that, copied while the list is copied, asks the request on the same thread.
class AskingWhenCopied {
public:
    struct State {
        Request* request = nullptr;
        bool asks = false;
        std::size_t handlersSeen = 0;
        std::shared_ptr<Result> resultSeen;
    };
    explicit AskingWhenCopied(State* state)
        : _state(state) {}
    AskingWhenCopied(const AskingWhenCopied& other)
        : _state(other._state) {
        if (!std::exchange(_state->asks, false))
            return;
        _state->handlersSeen = _state->request->handlers().size();
        _state->resultSeen = _state->request->result();
    }
    AskingWhenCopied& operator=(const AskingWhenCopied&) = delete;
    ~AskingWhenCopied() = default;
    void operator()(const std::shared_ptr<Result>&) const {}

private:
    State* _state;
};

TEST(IncidentFetcherRequest, TheThreadThatHoldsTheLockMayTakeItAgain) {
    const auto request = Request::initWithCompletionHandler(nullptr);
    AskingWhenCopied::State state{request.get()};
    request->addHandler(AskingWhenCopied(&state));
    state.asks = true;
    (void)request->handlers();
    EXPECT_EQ(std::exchange(state.handlersSeen, 0U), 1U);
    state.asks = true;
    request->setResultAndInvokeCompletionHandlers(makeResult());
    EXPECT_EQ(state.handlersSeen, 1U);
}

TEST(IncidentFetcherRequest, TheListIsCopiedAfterTheResultIsStored) {
    const auto request = Request::initWithCompletionHandler(nullptr);
    AskingWhenCopied::State state{request.get()};
    request->addHandler(AskingWhenCopied(&state));
    state.asks = true;
    const auto result = makeResult();
    request->setResultAndInvokeCompletionHandlers(result);
    EXPECT_EQ(state.resultSeen, result);
}

/// A handler that does something once when it is copied: that is while the list is copied, and the
/// lock held.
class ActingWhenCopied {
public:
    explicit ActingWhenCopied(std::function<void()>* action)
        : _action(action) {}
    ActingWhenCopied(const ActingWhenCopied& other)
        : _action(other._action) {
        if (const auto action = std::exchange(*_action, nullptr))
            action();
    }
    ActingWhenCopied& operator=(const ActingWhenCopied&) = delete;
    ~ActingWhenCopied() = default;
    void operator()(const std::shared_ptr<Result>&) const {}

private:
    std::function<void()>* _action;
};

/// Lets a request end, `patience` turns after another thread began to add a handler, while the lock
/// keeps that handler out of the list. Answers whether the handler was called; it is in the list
/// exactly when it was not.
bool callsAHandlerAddedWhileItEnds(int patience) {
    const auto request = Request::initWithCompletionHandler(nullptr);
    std::function<void()> whileLocked;
    request->addHandler(ActingWhenCopied(&whileLocked));
    std::atomic<bool> adding = false;
    std::atomic<std::size_t> calls = 0;
    std::thread joiner;
    whileLocked = [&] {
        joiner = std::thread([&] {
            adding = true;
            request->addHandler([&](const auto&) { ++calls; });
        });
        while (!adding)
            std::this_thread::yield();
        for (int turn = 0; turn < patience; ++turn)
            std::this_thread::yield();
        request->setResultAndInvokeCompletionHandlers(makeResult());
    };
    (void)request->handlers();
    joiner.join();
    EXPECT_EQ(request->handlers().size() + calls, 2U);
    return calls == 1;
}

TEST(IncidentFetcherRequest,
     AHandlerThatLookedForTheResultBeforeTheEndAndCameAfterItIsNeverCalled) {
    // Nothing shows that the other thread has looked and waits for the lock, so it is given more
    // and more turns for that.
    constexpr int enough = 1 << 20;
    int patience = 1;
    while (patience < enough && callsAHandlerAddedWhileItEnds(patience))
        patience *= 2;
    EXPECT_LT(patience, enough);
}

/// Handlers that know how often they were called, and a probe for which of them are in the list.
class Joiners {
public:
    explicit Joiners(std::size_t count)
        : _calls(count)
        , _inList(count)
        , _results(count) {}

    [[nodiscard]] std::size_t count() const { return _calls.size(); }
    CompletionHandler handler(std::size_t index) {
        return [this, index](const std::shared_ptr<Result>& result) {
            if (_probing) {
                ++_inList[index];
                return;
            }
            ++_calls[index];
            _results[index] = result.get();
        };
    }
    void probe(const std::vector<CompletionHandler>& handlers) {
        _probing = true;
        for (const auto& handler : handlers)
            handler(nullptr);
        _probing = false;
    }
    [[nodiscard]] int calls(std::size_t index) const { return _calls[index]; }
    [[nodiscard]] int inList(std::size_t index) const { return _inList[index]; }
    [[nodiscard]] const Result* result(std::size_t index) const { return _results[index]; }

private:
    std::vector<std::atomic<int>> _calls;
    std::vector<std::atomic<int>> _inList;
    std::vector<std::atomic<const Result*>> _results;
    std::atomic<bool> _probing = false;
};

TEST(IncidentFetcherRequest, ManyThreadsMayJoinWhileItEnds) {
    constexpr std::size_t threadCount = 8;
    constexpr std::size_t joinsPerThread = 200;
    constexpr std::size_t earlyCount = 16;
    for (int round = 0; round < 10; ++round) {
        Joiners joiners(earlyCount + threadCount * joinsPerThread);
        const auto request = Request::initWithCompletionHandler(joiners.handler(0));
        for (std::size_t i = 1; i < earlyCount; ++i)
            request->addHandler(joiners.handler(i));

        const auto result = makeResult();
        std::latch start(threadCount + 1);
        std::atomic<std::size_t> joined = 0;
        std::vector<std::thread> threads;
        threads.reserve(threadCount + 1);
        for (std::size_t thread = 0; thread < threadCount; ++thread)
            threads.emplace_back([&, first = earlyCount + thread * joinsPerThread] {
                start.arrive_and_wait();
                for (std::size_t i = first; i < first + joinsPerThread; ++i) {
                    request->addHandler(joiners.handler(i));
                    ++joined;
                    if (i % 16 == 0)
                        (void)request->handlers();
                    const auto ended = request->result();
                    EXPECT_TRUE(!ended || ended == result);
                }
            });
        threads.emplace_back([&] {
            start.arrive_and_wait();
            while (joined < threadCount * joinsPerThread / 2)
                std::this_thread::yield();
            request->setResultAndInvokeCompletionHandlers(result);
        });
        for (auto& thread : threads)
            thread.join();

        joiners.probe(request->handlers());
        std::size_t lost = 0;
        for (std::size_t i = 0; i < joiners.count(); ++i) {
            ASSERT_LE(joiners.calls(i), 1) << i;
            ASSERT_LE(joiners.inList(i), 1) << i;
            const bool wasCalled = joiners.calls(i) == 1;
            ASSERT_EQ(joiners.result(i), wasCalled ? result.get() : nullptr) << i;
            ASSERT_TRUE(wasCalled || i >= earlyCount) << i;
            // One that came between the look at the result and its adding is kept and not called.
            ASSERT_TRUE(wasCalled || joiners.inList(i) == 1) << i;
            lost += wasCalled ? 0 : 1;
        }
        // At most one join a thread can be under way when the request ends.
        ASSERT_LE(lost, threadCount);
    }
}

} // namespace
} // namespace orvo
