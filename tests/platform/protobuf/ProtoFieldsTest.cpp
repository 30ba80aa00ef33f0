#include "platform/protobuf/ProtoFields.h"

#include <gtest/gtest.h>

#include <limits>

namespace orvo {
namespace {

constexpr std::array Names{"None", "Some"};

TEST(ProtoFields, EnumerationValuesHaveNamesWithinTheirRange) {
    EXPECT_EQ(protoEnumAsString(Names, 1), "Some");
    EXPECT_EQ(protoEnumAsString(Names, 2), "(unknown: 2)");
    EXPECT_EQ(protoEnumAsString(Names, -1), "(unknown: -1)");
}

TEST(ProtoFields, UnknownNameIsZero) {
    EXPECT_EQ(protoStringAsEnum(Names, "Some"), 1);
    EXPECT_EQ(protoStringAsEnum(Names, "Favorites"), 0);
    EXPECT_EQ(protoStringAsEnum(Names, "some"), 0);
}

TEST(ProtoFields, DoubleHashKeepsAPositiveFractionAndDropsANegativeOne) {
    EXPECT_EQ(protoHash(2.25), 4611686023736259426U);
    EXPECT_EQ(protoHash(0.7), 2654435761U); // rounds up: the fraction would be below 0
    EXPECT_EQ(protoHash(0.25), 4611686018427387904U);
    EXPECT_EQ(protoHash(-0.0), 0U);
    EXPECT_EQ(protoHash(-2.25), protoHash(2.25));
}

TEST(ProtoFields, DoubleHashIsDefinedForEveryDouble) {
    EXPECT_EQ(protoHash(18446744073709551616.0), 0U); // 2^64 modulo 2^64
    EXPECT_EQ(protoHash(std::numeric_limits<double>::quiet_NaN()), 0U);
    EXPECT_EQ(protoHash(std::numeric_limits<double>::infinity()), 0U);
}

} // namespace
} // namespace orvo
