#include "handoff/NSDataOrvoExtra.h"

#include "platform/geoservices/Bzip2.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <random>

namespace orvo {
namespace {

using NSDataOrvoExtra::bzip2CompressedData;
using NSDataOrvoExtra::bzip2UncompressedData;

TEST(NSDataOrvoExtra, CompressesToAPlainStream) {
    const auto compressed = bzip2CompressedData(*NSData::dataWithString("incident"));
    ASSERT_TRUE(compressed);
    EXPECT_EQ(compressed->stringView().substr(0, 3), "BZh");
    EXPECT_EQ(bzip2UncompressedData(*compressed)->stringView(), "incident");
}

TEST(NSDataOrvoExtra, EmptyDataIsAValidStreamOfEmptyData) {
    const auto compressed = bzip2CompressedData(*NSData::dataWithString(""));
    ASSERT_TRUE(compressed);
    EXPECT_EQ(compressed->stringView().substr(0, 3), "BZh");
    const auto again = bzip2UncompressedData(*compressed);
    ASSERT_TRUE(again);
    EXPECT_EQ(again->length(), 0U);
}

TEST(NSDataOrvoExtra, BytesThatAreNotBzip2DecompressToNil) {
    EXPECT_FALSE(bzip2UncompressedData(*NSData::dataWithString("not bzip2 at all")));
    EXPECT_FALSE(bzip2UncompressedData(*NSData::dataWithString("")));
    EXPECT_FALSE(bzip2UncompressedData(*NSData::dataWithString("BZh9")));
}

TEST(NSDataOrvoExtra, TenMillionZerosComeBackWhole) {
    const auto zeros = NSData::dataWithVector(std::vector<std::uint8_t>(10'000'000, 0));
    const auto compressed = bzip2CompressedData(*zeros);
    ASSERT_TRUE(compressed);
    EXPECT_LT(compressed->length(), 1000U);
    EXPECT_TRUE(equal(bzip2UncompressedData(*compressed), zeros));
}

TEST(NSDataOrvoExtra, TruncatedStreamsDecompressToNilNotToAPrefix) {
    std::mt19937 generator(7); // NOLINT(cert-msc51-cpp): the same bytes in every run
    std::vector<std::uint8_t> bytes(3000);
    for (auto& byte : bytes)
        byte = static_cast<std::uint8_t>(generator() & 0xffU);
    const auto compressed = bzip2CompressedData(*NSData::dataWithVector(bytes));
    ASSERT_TRUE(compressed);
    EXPECT_TRUE(equal(bzip2UncompressedData(*compressed), NSData::dataWithVector(bytes)));
    for (std::size_t length = 0; length < compressed->length(); length += 7)
        EXPECT_FALSE(
            bzip2UncompressedData(*NSData::dataWithBytes(compressed->bytes().first(length))))
            << length;
}

TEST(NSDataOrvoExtra, BytesBehindTheStreamAreRefused) {
    const auto compressed = bzip2CompressedData(*NSData::dataWithString("a"));
    EXPECT_FALSE(bzip2UncompressedData(
        *NSData::dataWithString(std::string(compressed->stringView()) + "x")));
}

TEST(NSDataOrvoExtra, CompressedDataIsTheRoutinesOwnBufferNotACopy) {
    const std::uint8_t* made = nullptr;
    const auto scope = Bzip2Compressor().overrideWith(
        [&](const std::uint8_t*, std::size_t, std::uint8_t** output, std::size_t* length) {
            *output = static_cast<std::uint8_t*>(std::calloc(5, 1)); // freed with the data
            *length = 5;
            made = *output;
            return true;
        });
    const auto compressed = bzip2CompressedData(*NSData::dataWithString("a"));
    ASSERT_TRUE(compressed);
    EXPECT_EQ(compressed->bytes().data(), made);
    EXPECT_EQ(compressed->length(), 5U);
}

TEST(NSDataOrvoExtra, FailedCompressionFreesItsBufferAndAnswersNil) {
    const auto scope = Bzip2Compressor().overrideWith(
        [](const std::uint8_t*, std::size_t, std::uint8_t** output, std::size_t* length) {
            *output = static_cast<std::uint8_t*>(
                std::malloc(64)); // the leak check sees whether it is freed
            *length = 64;
            return false;
        });
    EXPECT_FALSE(bzip2CompressedData(*NSData::dataWithString("a")));
}

} // namespace
} // namespace orvo
