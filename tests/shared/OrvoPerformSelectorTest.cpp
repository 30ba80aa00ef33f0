#include "shared/OrvoPerformSelector.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

class Greeter final : public virtual NSObject {
public:
    Method methodForSelector(const Selector& selector) override {
        if (selector == Selector("greet"))
            return [](const auto& sender) -> std::shared_ptr<NSObject> {
                return NSString::string(sender ? "hello you" : "hello");
            };
        if (selector == Selector("silence"))
            return [](const auto&) {
                return nullptr;
            };
        return NSObject::methodForSelector(selector);
    }
};

TEST(OrvoPerformSelector, AnswersWhatTheMethodAnswers) {
    const auto greeter = std::make_shared<Greeter>();
    EXPECT_TRUE(equal(OrvoPerformSelector(greeter, Selector("greet")), NSString::string("hello")));
    EXPECT_EQ(OrvoPerformSelector(greeter, Selector("silence")), nullptr);
}

TEST(OrvoPerformSelector, OfNilIsNil) {
    EXPECT_EQ(OrvoPerformSelector(nullptr, Selector("greet")), nullptr);
}

TEST(OrvoPerformSelector, RaisesForAMethodThatTheObjectDoesNotHave) {
    EXPECT_THROW((void)OrvoPerformSelector(std::make_shared<Greeter>(), Selector("fly")),
                 NSInvalidArgumentException);
}

} // namespace
} // namespace orvo
