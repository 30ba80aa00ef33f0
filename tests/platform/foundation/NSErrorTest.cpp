#include "platform/foundation/NSError.h"

#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(NSError, SaysItsMessageOrElseDomainAndCode) {
    EXPECT_EQ(NSError::errorWithMessage("D", 3, "Gone.")->localizedDescription(), "Gone.");
    const auto bare = NSError::errorWithDomain_code_userInfo("D", 3, nullptr);
    EXPECT_EQ(bare->localizedDescription(), "The operation could not be completed. (D error 3.)");
    const auto noText = NSError::errorWithDomain_code_userInfo(
        "D",
        3,
        NSDictionary::dictionaryWithTextKeys(
            {{NSLocalizedDescriptionKey, NSNumber::numberWithInteger(1)}}));
    EXPECT_EQ(noText->localizedDescription(), bare->localizedDescription());
}

TEST(NSError, KeepsWhatItIsMadeOf) {
    const auto cause = NSError::errorWithMessage(NSPOSIXErrorDomain, 2, "No such file");
    const auto error = NSError::errorWithDomain_code_userInfo(
        NSCocoaErrorDomain,
        -7,
        NSDictionary::dictionaryWithTextKeys({{NSUnderlyingErrorKey, cause}}));
    EXPECT_EQ(error->domain(), "NSCocoaErrorDomain");
    EXPECT_EQ(error->code(), -7);
    EXPECT_EQ(error->userInfo()->objectForKey(NSUnderlyingErrorKey), cause);
}

TEST(NSError, IsEqualByDomainCodeAndUserInfoAndHashesAlike) {
    const auto error = NSError::errorWithMessage("D", 3, "m");
    const auto same = NSError::errorWithMessage("D", 3, "m");
    EXPECT_TRUE(error->isEqual(same.get()));
    EXPECT_TRUE(same->isEqual(error.get()));
    EXPECT_EQ(error->hash(), same->hash());
    for (const auto& other : {NSError::errorWithMessage("E", 3, "m"),
                              NSError::errorWithMessage("D", 4, "m"),
                              NSError::errorWithMessage("D", 3, "n"),
                              NSError::errorWithDomain_code_userInfo("D", 3, nullptr)}) {
        EXPECT_FALSE(error->isEqual(other.get())) << other->description();
        EXPECT_FALSE(other->isEqual(error.get())) << other->description();
    }
    EXPECT_FALSE(error->isEqual(nullptr));
}

TEST(NSError, DescribesItself) {
    EXPECT_EQ(NSError::errorWithMessage("D", -3, "Gone.")->description(),
              "Error Domain=D Code=-3 \"Gone.\"");
}

TEST(NSError, IsItsOwnCopy) {
    const auto error = NSError::errorWithMessage("D", 3, "m");
    EXPECT_EQ(error->copy(), error);
}

} // namespace
} // namespace orvo
