#include "platform/feeds/schedule/private/ZipLibrary.h"

#include <gtest/gtest.h>

using namespace orvo;

TEST(ZipLibraryTest, IsOpenedOnceAndWhole) {
    std::string reason;
    const auto* const library = ZipLibrary::shared(reason);
    ASSERT_NE(library, nullptr) << reason;
    EXPECT_EQ(ZipLibrary::shared(reason), library);
    zip_error_t error{};
    library->errorInit(&error);
    EXPECT_EQ(library->open(nullptr, ZIP_RDONLY, &error), nullptr);
    EXPECT_STREQ(library->errorText(&error), "Invalid argument");
    library->errorFini(&error);
    EXPECT_EQ(reason, "");
}

TEST(ZipLibraryTest, SaysWhichLibraryIsMissing) {
    std::string reason;
    EXPECT_FALSE(ZipLibrary::named("libnowhere.so.7", reason));
    EXPECT_NE(reason.find("libnowhere.so.7"), std::string::npos) << reason;
}

TEST(ZipLibraryTest, SaysWhichFunctionIsMissing) {
    std::string reason;
    EXPECT_FALSE(ZipLibrary::named("libc.so.6", reason));
    EXPECT_NE(reason.find("zip_discard"), std::string::npos) << reason;
}
