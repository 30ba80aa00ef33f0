#include "shared/NSError_OrvoSharedExtras.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using OrvoSharedExtras::_orvo_cancellationError;
using OrvoSharedExtras::_orvo_isCancellation;
using OrvoSharedExtras::_orvo_isErrorOfDomain_code;

std::shared_ptr<NSError> makeError(const char* domain, std::int64_t code) {
    return NSError::errorWithMessage(domain, code, "it broke");
}

TEST(CancellationError, IsTheUserCancelledErrorWithoutUserInfo) {
    const auto error = _orvo_cancellationError();
    EXPECT_EQ(error->domain(), "NSCocoaErrorDomain");
    EXPECT_EQ(error->code(), 3072);
    EXPECT_EQ(error->userInfo(), nullptr);
}

TEST(CancellationError, IsNewEachTime) {
    EXPECT_NE(_orvo_cancellationError(), _orvo_cancellationError());
}

TEST(CancellationError, IsRecognisedByDomainAndCode) {
    EXPECT_TRUE(_orvo_isCancellation(_orvo_cancellationError()));
    EXPECT_TRUE(_orvo_isCancellation(makeError("NSCocoaErrorDomain", 3072)));
    EXPECT_FALSE(_orvo_isCancellation(makeError("NSPOSIXErrorDomain", 3072)));
    EXPECT_FALSE(_orvo_isCancellation(makeError("nscocoaerrordomain", 3072)));
    EXPECT_FALSE(_orvo_isCancellation(makeError("NSCocoaErrorDomain", 3073)));
    EXPECT_FALSE(_orvo_isCancellation(nullptr));
}

TEST(ErrorOfDomainAndCode, NeedsBothToBeEqual) {
    const auto error = makeError("Feeds", -4);
    EXPECT_TRUE(_orvo_isErrorOfDomain_code(error, "Feeds", -4));
    EXPECT_FALSE(_orvo_isErrorOfDomain_code(error, "Feeds", 4));
    EXPECT_FALSE(_orvo_isErrorOfDomain_code(error, "Feed", -4));
    EXPECT_FALSE(_orvo_isErrorOfDomain_code(nullptr, "Feeds", -4));
}

} // namespace
} // namespace orvo
