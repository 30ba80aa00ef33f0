#include "widget/result/Result.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "support/LogCapture.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <thread>
#include <type_traits>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using testing::LogCapture;

constexpr std::uint64_t TrueInHashes = 2654435761U;

std::shared_ptr<NSError> makeError(std::int64_t code = 7) {
    return NSError::errorWithMessage("TestDomain", code, "it broke");
}

/// Counts the calls of two blocks and keeps what they were given.
struct Blocks {
    int values = 0;
    int errors = 0;
    Result::Value value;
    Result::Error error;
    std::thread::id thread;

    std::function<void(const Result::Value&)> onValue() {
        return [this](const Result::Value& given) {
            ++values;
            value = given;
            thread = std::this_thread::get_id();
        };
    }
    std::function<void(const Result::Error&)> onError() {
        return [this](const Result::Error& given) {
            ++errors;
            error = given;
            thread = std::this_thread::get_id();
        };
    }
};

/// Content with a hash and an opinion on equality of its own; it remembers being asked.
class Opinion final : public virtual NSObject {
public:
    Opinion(bool givenAnswer, std::uint64_t givenHash)
        : answer(givenAnswer)
        , hashValue(givenHash) {}

    bool isEqual(const NSObject* other) const override {
        ++timesAsked;
        lastOther = other;
        return answer;
    }
    std::uint64_t hash() const override { return hashValue; }
    std::string description() const override { return "Opinion>"; }

    bool answer;
    std::uint64_t hashValue;
    mutable int timesAsked = 0;
    mutable const NSObject* lastOther = nullptr;
};

/// An error with an opinion on equality, so that value and error can be one object.
class ErrorOpinion final : public NSError {
public:
    explicit ErrorOpinion(bool givenAnswer)
        : answer(givenAnswer) {}

    bool isEqual(const NSObject*) const override {
        ++timesAsked;
        return answer;
    }
    std::uint64_t hash() const override { return 99; }

    bool answer;
    mutable int timesAsked = 0;
};

class SpecialResult final : public Result {
public:
    static std::shared_ptr<SpecialResult> initWithSuccess(const Value& value) {
        auto result = std::make_shared<SpecialResult>();
        return result->_initWithSuccess(value) ? result : nullptr;
    }
};

/// A class whose name holds the bracket in which root descriptions end.
class OddlyNamedResult final : public Result {
public:
    static std::shared_ptr<OddlyNamedResult> initWithSuccess(const Value& value) {
        auto result = std::make_shared<OddlyNamedResult>();
        return result->_initWithSuccess(value) ? result : nullptr;
    }
    std::string className() const override { return "Odd>Name"; }
};

template <class T>
concept HandsOutItsValue = requires(const T& result) {
    result.value();
}
|| requires(const T& result) {
    result._value;
};
template <class T>
concept HandsOutItsError = requires(const T& result) {
    result.error();
}
|| requires(const T& result) {
    result._error;
};

template <class Action>
std::string textOfInvalidArgument(const Action& action) {
    try {
        action();
    } catch (const NSInvalidArgumentException& exception) {
        return exception.what();
    }
    return "nothing was raised";
}

// Making one

TEST(Result, WithAValueIsASuccess) {
    EXPECT_TRUE(Result::resultWithValue(NSString::string("x"))->isSuccess());
    EXPECT_TRUE(Result::initWithSuccess(NSString::string("x"))->isSuccess());
}

TEST(Result, WithAnErrorIsAFailure) {
    EXPECT_FALSE(Result::resultWithError(makeError())->isSuccess());
    EXPECT_FALSE(Result::initWithError(makeError())->isSuccess());
}

TEST(Result, AnErrorGivenAsTheValueIsASuccess) {
    EXPECT_TRUE(Result::resultWithValue(makeError())->isSuccess());
}

TEST(Result, NilValueRaisesValueCannotBeNil) {
    EXPECT_EQ(textOfInvalidArgument([] { (void)Result::resultWithValue(nullptr); }),
              "Value cannot be nil");
    EXPECT_EQ(textOfInvalidArgument([] { (void)Result::initWithSuccess(nullptr); }),
              "Value cannot be nil");
}

TEST(Result, NilErrorRaisesErrorCannotBeNil) {
    EXPECT_EQ(textOfInvalidArgument([] { (void)Result::resultWithError(nullptr); }),
              "Error cannot be nil");
    EXPECT_EQ(textOfInvalidArgument([] { (void)Result::initWithError(nullptr); }),
              "Error cannot be nil");
}

TEST(Result, HandsOutItsContentOnlyToBlocks) {
    EXPECT_FALSE(HandsOutItsValue<Result>);
    EXPECT_FALSE(HandsOutItsError<Result>);
    EXPECT_FALSE(std::is_copy_assignable_v<Result>);
}

TEST(Result, LetsGoOfItsContentAtItsEnd) {
    auto value = std::make_shared<Opinion>(true, 1);
    const std::weak_ptr<Opinion> watch = value;
    auto result = Result::resultWithValue(std::move(value));
    EXPECT_FALSE(watch.expired());
    result.reset();
    EXPECT_TRUE(watch.expired());
}

// withValue_orError

TEST(Result, SuccessCallsTheValueBlockOnceOnTheCallersThread) {
    Blocks blocks;
    const auto value = NSString::string("x");
    Result::resultWithValue(value)->withValue_orError(blocks.onValue(), blocks.onError());
    EXPECT_EQ(blocks.values, 1);
    EXPECT_EQ(blocks.errors, 0);
    EXPECT_EQ(blocks.value, value);
    EXPECT_EQ(blocks.thread, std::this_thread::get_id());
}

TEST(Result, FailureCallsTheErrorBlockOnceOnTheCallersThread) {
    Blocks blocks;
    const auto error = makeError();
    Result::resultWithError(error)->withValue_orError(blocks.onValue(), blocks.onError());
    EXPECT_EQ(blocks.values, 0);
    EXPECT_EQ(blocks.errors, 1);
    EXPECT_EQ(blocks.error, error);
    EXPECT_EQ(blocks.thread, std::this_thread::get_id());
}

TEST(Result, CallsBlocksOnWhateverThreadAsks) {
    Blocks blocks;
    const auto result = Result::resultWithValue(NSString::string("x"));
    std::thread::id asker;
    std::thread([&] {
        asker = std::this_thread::get_id();
        result->withValue_orError(blocks.onValue(), blocks.onError());
    }).join();
    EXPECT_EQ(blocks.thread, asker);
}

TEST(Result, CallsTheBlockOfWhatItHoldsSoNoneBeforeItHoldsAnything) {
    const LogCapture log;
    Blocks blocks;
    const auto allocated = std::make_shared<Result>();
    allocated->withValue_orError(blocks.onValue(), blocks.onError());
    EXPECT_EQ(blocks.values, 0);
    EXPECT_EQ(blocks.errors, 0);
    EXPECT_THAT(log.messages(), IsEmpty());
    allocated->withValue_orError(nullptr, nullptr);
    EXPECT_THAT(log.messages(), ElementsAre("Neither block can be nil but both are nil."));
}

TEST(Result, WithBothBlocksLogsNothing) {
    const LogCapture log;
    Blocks blocks;
    Result::resultWithValue(NSString::string("x"))
        ->withValue_orError(blocks.onValue(), blocks.onError());
    Result::resultWithError(makeError())->withValue_orError(blocks.onValue(), blocks.onError());
    EXPECT_THAT(log.messages(), IsEmpty());
}

TEST(Result, MisuseIsLoggedAtErrorLevelInItsOwnCategory) {
    const LogCapture log;
    Blocks blocks;
    Result::resultWithError(makeError())->withValue_orError(nullptr, blocks.onError());
    ASSERT_EQ(log.records().size(), 1U);
    EXPECT_EQ(log.records()[0].level, LogLevel::Error);
    EXPECT_EQ(log.records()[0].category, "Result");
    EXPECT_EQ(log.records()[0].subsystem, Log::DefaultSubsystem);
    EXPECT_EQ(log.records()[0].format, "%@");
    EXPECT_EQ(log.records()[0].redacted, "Neither block can be nil but value block is nil.");
}

TEST(Result, SuccessWithoutAValueBlockCallsNothingAndSaysSo) {
    const LogCapture log;
    Blocks blocks;
    Result::resultWithValue(NSString::string("x"))->withValue_orError(nullptr, blocks.onError());
    EXPECT_EQ(blocks.errors, 0);
    ASSERT_THAT(log.messages(),
                ElementsAre("Neither block can be nil but value block is nil.",
                            "Had a value but no value block"));
    EXPECT_EQ(log.records()[1].level, LogLevel::Error);
    EXPECT_EQ(log.records()[1].category, "Result");
}

TEST(Result, FailureWithoutAnErrorBlockCallsNothingAndSaysSo) {
    const LogCapture log;
    Blocks blocks;
    Result::resultWithError(makeError())->withValue_orError(blocks.onValue(), nullptr);
    EXPECT_EQ(blocks.values, 0);
    ASSERT_THAT(log.messages(),
                ElementsAre("Neither block can be nil but error block is nil.",
                            "Had an error but no error block"));
    EXPECT_EQ(log.records()[1].level, LogLevel::Error);
    EXPECT_EQ(log.records()[1].category, "Result");
}

TEST(Result, SuccessWithoutAnErrorBlockStillCallsTheValueBlock) {
    const LogCapture log;
    Blocks blocks;
    Result::resultWithValue(NSString::string("x"))->withValue_orError(blocks.onValue(), nullptr);
    EXPECT_EQ(blocks.values, 1);
    EXPECT_THAT(log.messages(), ElementsAre("Neither block can be nil but error block is nil."));
}

TEST(Result, FailureWithoutAValueBlockStillCallsTheErrorBlockAfterLogging) {
    const LogCapture log;
    std::vector<std::string> linesBeforeTheCall;
    Result::resultWithError(makeError())->withValue_orError(nullptr, [&](const auto&) {
        linesBeforeTheCall = log.messages();
    });
    EXPECT_THAT(linesBeforeTheCall,
                ElementsAre("Neither block can be nil but value block is nil."));
    EXPECT_EQ(log.messages(), linesBeforeTheCall);
}

TEST(Result, WithoutAnyBlockNamesBothAndThenTheSideHeld) {
    const LogCapture log;
    Result::resultWithValue(NSString::string("x"))->withValue_orError(nullptr, nullptr);
    Result::resultWithError(makeError())->withValue_orError(nullptr, nullptr);
    EXPECT_THAT(log.messages(),
                ElementsAre("Neither block can be nil but both are nil.",
                            "Had a value but no value block",
                            "Neither block can be nil but both are nil.",
                            "Had an error but no error block"));
}

TEST(Result, MisuseLineHasOneOfThreeEndings) {
    const auto result = Result::resultWithError(makeError());
    EXPECT_EQ(result->_errorMessageForValue_error(true, true),
              "Neither block can be nil but both are nil.");
    EXPECT_EQ(result->_errorMessageForValue_error(true, false),
              "Neither block can be nil but value block is nil.");
    EXPECT_EQ(result->_errorMessageForValue_error(false, true),
              "Neither block can be nil but error block is nil.");
}

TEST(Result, MisuseLineWithNothingMissingEndsWithTheErrorBlock) {
    EXPECT_EQ(Result::resultWithError(makeError())->_errorMessageForValue_error(false, false),
              "Neither block can be nil but error block is nil.");
}

// map and flatMap

TEST(Result, MapOfASuccessIsANewSuccessWithTheBlocksAnswer) {
    const auto success = Result::resultWithValue(NSString::string("x"));
    const auto answer = NSNumber::numberWithInteger(3);
    Result::Value given;
    const auto mapped = success->map([&](const Result::Value& value) -> Result::Value {
        given = value;
        return answer;
    });
    Blocks blocks;
    mapped->withValue_orError(blocks.onValue(), blocks.onError());
    EXPECT_TRUE(equal(given, NSString::string("x")));
    EXPECT_EQ(blocks.value, answer);
    EXPECT_NE(mapped, success);
}

TEST(Result, MapAndFlatMapOfAFailureAnswerTheFailureItself) {
    const auto failure = Result::resultWithError(makeError());
    int calls = 0;
    EXPECT_EQ(failure->map([&](const Result::Value& value) {
        ++calls;
        return value;
    }),
              failure);
    EXPECT_EQ(failure->flatMap([&](const Result::Value& value) {
        ++calls;
        return Result::resultWithValue(value);
    }),
              failure);
    EXPECT_EQ(calls, 0);
}

TEST(Result, FlatMapOfASuccessIsTheBlocksResultItself) {
    const auto success = Result::resultWithValue(NSString::string("x"));
    std::shared_ptr<Result> answer;
    const auto block = [&](const Result::Value&) {
        return answer = Result::resultWithError(makeError());
    };
    EXPECT_EQ(success->flatMap(block), answer);
}

TEST(Result, FlatMapToNilIsNil) {
    const auto success = Result::resultWithValue(NSString::string("x"));
    EXPECT_EQ(success->flatMap([](const auto&) { return std::shared_ptr<Result>(); }), nullptr);
}

TEST(Result, MapToNilRaisesValueCannotBeNil) {
    const auto success = Result::resultWithValue(NSString::string("x"));
    EXPECT_EQ(textOfInvalidArgument(
                  [&] { (void)success->map([](const auto&) { return Result::Value(); }); }),
              "Value cannot be nil");
}

TEST(Result, MapAndFlatMapRunTheirBlockOnTheCallersThread) {
    const auto success = Result::resultWithValue(NSString::string("x"));
    std::thread::id asker;
    std::thread::id inMap;
    std::thread::id inFlatMap;
    std::thread([&] {
        asker = std::this_thread::get_id();
        (void)success->map([&](const Result::Value& value) {
            inMap = std::this_thread::get_id();
            return value;
        });
        (void)success->flatMap([&](const Result::Value& value) {
            inFlatMap = std::this_thread::get_id();
            return Result::resultWithValue(value);
        });
    }).join();
    EXPECT_EQ(inMap, asker);
    EXPECT_EQ(inFlatMap, asker);
}

// Equality, hash, description

TEST(Result, SuccessesWithEqualValuesAreEqualAndHashAlike) {
    const auto a = Result::resultWithValue(NSString::string("x"));
    const auto b = Result::resultWithValue(NSString::string("x"));
    EXPECT_TRUE(a->isEqual(b.get()));
    EXPECT_TRUE(b->isEqual(a.get()));
    EXPECT_TRUE(a->isEqualToResult(b.get()));
    EXPECT_EQ(a->hash(), b->hash());
}

TEST(Result, SuccessesWithDifferentValuesAreNotEqual) {
    const auto a = Result::resultWithValue(NSString::string("x"));
    const auto b = Result::resultWithValue(NSString::string("y"));
    EXPECT_FALSE(a->isEqual(b.get()));
    EXPECT_FALSE(a->isEqualToResult(b.get()));
}

TEST(Result, FailuresAreEqualByTheirErrors) {
    const auto a = Result::resultWithError(makeError(1));
    const auto b = Result::resultWithError(makeError(1));
    const auto c = Result::resultWithError(makeError(2));
    EXPECT_TRUE(a->isEqual(b.get()));
    EXPECT_EQ(a->hash(), b->hash());
    EXPECT_FALSE(a->isEqual(c.get()));
    EXPECT_FALSE(a->isEqualToResult(c.get()));
}

TEST(Result, SuccessAndFailureAreNeverEqualEvenWithTheSameContent) {
    const auto content = std::make_shared<ErrorOpinion>(true);
    const auto success = Result::resultWithValue(content);
    const auto failure = Result::resultWithError(content);
    EXPECT_FALSE(success->isEqual(failure.get()));
    EXPECT_FALSE(failure->isEqual(success.get()));
    EXPECT_FALSE(success->isEqualToResult(failure.get()));
    EXPECT_FALSE(failure->isEqualToResult(success.get()));
    EXPECT_EQ(content->timesAsked, 0);
}

TEST(Result, IsEqualToItselfWithoutAskingItsContent) {
    const auto content = std::make_shared<Opinion>(false, 1);
    const auto result = Result::resultWithValue(content);
    EXPECT_TRUE(result->isEqual(result.get()));
    EXPECT_EQ(content->timesAsked, 0);
    EXPECT_FALSE(result->isEqualToResult(result.get()));
}

TEST(Result, IsNeverEqualToNilOrToAnotherClass) {
    const auto value = NSString::string("x");
    const auto result = Result::resultWithValue(value);
    EXPECT_FALSE(result->isEqual(nullptr));
    EXPECT_FALSE(result->isEqual(value.get()));
    EXPECT_FALSE(result->isEqualToResult(nullptr));
    EXPECT_FALSE(Result::resultWithError(makeError())->isEqualToResult(nullptr));
}

TEST(Result, ASubclassInstanceIsNotEqualInEitherDirection) {
    const auto value = NSString::string("x");
    const auto plain = Result::resultWithValue(value);
    const auto special = SpecialResult::initWithSuccess(value);
    EXPECT_FALSE(plain->isEqual(special.get()));
    EXPECT_FALSE(special->isEqual(plain.get()));
    EXPECT_TRUE(special->isEqual(SpecialResult::initWithSuccess(value).get()));
}

TEST(Result, TheOthersContentIsAskedWhetherItIsEqual) {
    const auto yes = std::make_shared<Opinion>(true, 1);
    const auto no = std::make_shared<Opinion>(false, 1);
    const auto withYes = Result::resultWithValue(yes);
    const auto withNo = Result::resultWithValue(no);
    EXPECT_FALSE(withYes->isEqualToResult(withNo.get()));
    EXPECT_EQ(yes->timesAsked, 0);
    EXPECT_EQ(no->lastOther, yes.get());
    EXPECT_TRUE(withNo->isEqualToResult(withYes.get()));
}

TEST(Result, TheOthersErrorIsAskedWhetherItIsEqual) {
    const auto yes = Result::resultWithError(std::make_shared<ErrorOpinion>(true));
    const auto no = Result::resultWithError(std::make_shared<ErrorOpinion>(false));
    EXPECT_FALSE(yes->isEqualToResult(no.get()));
    EXPECT_TRUE(no->isEqualToResult(yes.get()));
}

TEST(Result, ASuccessHashesToItsValueWithTheMarkForTrue) {
    EXPECT_EQ(Result::resultWithValue(std::make_shared<Opinion>(true, 0))->hash(), TrueInHashes);
    EXPECT_EQ(
        Result::resultWithValue(std::make_shared<Opinion>(true, 0x123456789abcdefULL))->hash(),
        0x123456789abcdefULL ^ TrueInHashes);
}

TEST(Result, AFailureHashesToItsErrorAlone) {
    const auto error = makeError();
    EXPECT_EQ(Result::resultWithError(error)->hash(), error->hash());
    EXPECT_EQ(Result::resultWithError(std::make_shared<ErrorOpinion>(true))->hash(), 99U);
}

TEST(Result, DescriptionHoldsTheContentsBeforeTheClosingBracket) {
    const auto success = Result::resultWithValue(NSString::string("x"));
    std::string root = success->rootDescription();
    EXPECT_EQ(root.substr(0, 11), "<Result: 0x");
    root.pop_back();
    EXPECT_EQ(success->description(), root + " " + NSString::string("x")->description() + ">");

    const auto failure = Result::resultWithError(makeError());
    root = failure->rootDescription();
    root.pop_back();
    EXPECT_EQ(failure->description(), root + " " + makeError()->description() + ">");
}

TEST(Result, DescriptionHoldsTheContentsBeforeEveryClosingBracketOfTheRoot) {
    const auto result = OddlyNamedResult::initWithSuccess(std::make_shared<Opinion>(true, 1));
    std::string root = result->rootDescription();
    ASSERT_EQ(root.substr(0, 10), "<Odd>Name:");
    root.pop_back();
    EXPECT_EQ(result->description(), "<Odd Opinion>>" + root.substr(5) + " Opinion>>");
}

TEST(Result, DescriptionLeavesBracketsOfTheContentAlone) {
    const auto result = Result::resultWithValue(std::make_shared<Opinion>(true, 1));
    std::string root = result->rootDescription();
    root.pop_back();
    EXPECT_EQ(result->description(), root + " Opinion>>");
}

TEST(Result, DescriptionWithoutContentIsTheRootDescription) {
    const auto allocated = std::make_shared<Result>();
    EXPECT_EQ(allocated->description(), allocated->rootDescription());
}

} // namespace
} // namespace orvo
