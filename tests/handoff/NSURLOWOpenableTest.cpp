#include "handoff/NSURLOWOpenable.h"

#include "handoff/Doubles.h"
#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace orvo {
namespace {

std::shared_ptr<NSURLOWOpenable> openable(const char* url) {
    return NSURLOWOpenable::openableWithURL(NSURL::URLWithString(url));
}

TEST(NSURLOWOpenable, SharesTheSessionThenConvertsThenOpens) {
    const testing::OpeningDoubles doubles;
    openable("orvo://?t=r")->openInContext_completionHandler(doubles.controller, {});
    EXPECT_EQ(*doubles.journal,
              (std::vector<std::string>{"session callback=0 share=1 reset=0",
                                        "conversion",
                                        "open orvo://?t=r&session=S1"}));
    doubles.context->handler(true); // an empty handler is nobody's to call
}

TEST(NSURLOWOpenable, AContextThatIsNoViewControllerDoesNothingAtAll) {
    const testing::OpeningDoubles doubles;
    bool called = false;
    const auto handler = [&](bool, const std::shared_ptr<NSError>&) {
        called = true;
    };
    openable("orvo://?t=r")->openInContext_completionHandler(NSString::string("context"), handler);
    openable("orvo://?t=r")->openInContext_completionHandler(nullptr, handler);
    EXPECT_TRUE(doubles.journal->empty());
    EXPECT_FALSE(called);
}

TEST(NSURLOWOpenable, AControllerOutsideAHostNeverAnswers) {
    const testing::OpeningDoubles doubles;
    doubles.controller->setExtensionContext(nullptr);
    bool called = false;
    openable("orvo://?t=r")
        ->openInContext_completionHandler(
            doubles.controller, [&](bool, const std::shared_ptr<NSError>&) { called = true; });
    EXPECT_EQ(*doubles.journal,
              (std::vector<std::string>{"session callback=0 share=1 reset=0", "conversion"}));
    EXPECT_FALSE(called);
}

TEST(NSURLOWOpenable, AnswersTheFlagWithoutAnErrorEvenWhenItDidNotOpen) {
    const testing::OpeningDoubles doubles;
    std::vector<bool> answers;
    openable("orvo://?t=r")
        ->openInContext_completionHandler(doubles.controller,
                                          [&](bool success, const std::shared_ptr<NSError>& error) {
                                              answers.push_back(success);
                                              EXPECT_FALSE(error);
                                          });
    EXPECT_TRUE(answers.empty());
    doubles.context->handler(false);
    doubles.context->handler(true);
    EXPECT_EQ(answers, (std::vector<bool>{false, true}));
}

TEST(NSURLOWOpenable, ConvertsAnAlreadyConvertedURLAgainToTheSame) {
    const testing::OpeningDoubles doubles;
    openable("orvo://?favorites=2&t=r&session=S1")
        ->openInContext_completionHandler(doubles.controller, {});
    EXPECT_EQ(doubles.journal->back(), "open orvo://?favorites=2&t=r&session=S1");
    EXPECT_EQ(std::ranges::count(*doubles.journal, "conversion"), 1);
}

TEST(NSURLOWOpenable, EqualsHashesAndDescribesAsItsURL) {
    const auto url = NSURL::URLWithString("orvo://?t=r");
    EXPECT_TRUE(equal(openable("orvo://?t=r"), openable("orvo://?t=r")));
    EXPECT_TRUE(equal(openable("orvo://?t=r"), url));
    EXPECT_FALSE(equal(openable("orvo://?t=r"), openable("orvo://?t=m")));
    EXPECT_EQ(openable("orvo://?t=r")->hash(), url->hash());
    EXPECT_EQ(openable("orvo://?t=r")->description(), "orvo://?t=r");
    EXPECT_FALSE(NSURLOWOpenable::openableWithURL(nullptr));
}

} // namespace
} // namespace orvo
