#include "platform/foundation/NSNumber.h"

#include <gtest/gtest.h>

#include <limits>
#include <vector>

namespace orvo {
namespace {

using Signed = std::numeric_limits<std::int64_t>;
using Unsigned = std::numeric_limits<std::uint64_t>;
constexpr double NotANumber = std::numeric_limits<double>::quiet_NaN();
constexpr double Infinity = std::numeric_limits<double>::infinity();

using Numbers = std::vector<std::shared_ptr<NSNumber>>;

void expectAllEqual(const Numbers& numbers) {
    for (const auto& a : numbers)
        for (const auto& b : numbers) {
            EXPECT_TRUE(a->isEqual(b.get())) << a->description();
            EXPECT_EQ(a->hash(), b->hash()) << a->description();
        }
}

void expectAllDifferent(const Numbers& numbers) {
    for (const auto& a : numbers)
        for (const auto& b : numbers)
            EXPECT_EQ(a->isEqual(b.get()), a == b) << a->description() << " " << b->description();
}

TEST(NSNumber, IsEqualToTheSameNumberOfAnyType) {
    expectAllEqual({NSNumber::numberWithBool(true),
                    NSNumber::numberWithInteger(1),
                    NSNumber::numberWithUnsignedInteger(1),
                    NSNumber::numberWithDouble(1.0)});
    expectAllEqual({NSNumber::numberWithBool(false),
                    NSNumber::numberWithInteger(0),
                    NSNumber::numberWithUnsignedInteger(0),
                    NSNumber::numberWithDouble(0.0),
                    NSNumber::numberWithDouble(-0.0)});
    expectAllEqual({NSNumber::numberWithInteger(-7), NSNumber::numberWithDouble(-7.0)});
    expectAllEqual({NSNumber::numberWithInteger(Signed::min()),
                    NSNumber::numberWithDouble(-9223372036854775808.0)});
    expectAllEqual({NSNumber::numberWithUnsignedInteger(1ULL << 63),
                    NSNumber::numberWithDouble(9223372036854775808.0)});
}

TEST(NSNumber, IsNotEqualToANeighbourThatADoubleCannotTell) {
    expectAllDifferent({NSNumber::numberWithInteger(Signed::max()),
                        NSNumber::numberWithDouble(9223372036854775808.0),
                        NSNumber::numberWithUnsignedInteger(Unsigned::max()),
                        NSNumber::numberWithDouble(18446744073709551616.0),
                        NSNumber::numberWithInteger(-1),
                        NSNumber::numberWithInteger(Signed::min())});
}

TEST(NSNumber, ComparesFractionsAndWhatIsNotFinite) {
    expectAllDifferent({NSNumber::numberWithDouble(0.5),
                        NSNumber::numberWithDouble(-0.5),
                        NSNumber::numberWithInteger(0),
                        NSNumber::numberWithDouble(Infinity),
                        NSNumber::numberWithDouble(-Infinity),
                        NSNumber::numberWithDouble(NotANumber)});
    expectAllEqual({NSNumber::numberWithDouble(0.5), NSNumber::numberWithDouble(0.5)});
    expectAllEqual(
        {NSNumber::numberWithDouble(NotANumber), NSNumber::numberWithDouble(-NotANumber)});
}

TEST(NSNumber, IsNeverEqualToNil) {
    EXPECT_FALSE(NSNumber::numberWithInteger(0)->isEqual(nullptr));
}

TEST(NSNumber, SaturatesAtTheLimitsOfASignedNumber) {
    EXPECT_EQ(NSNumber::numberWithUnsignedInteger(Unsigned::max())->integerValue(), Signed::max());
    EXPECT_EQ(NSNumber::numberWithDouble(1e300)->integerValue(), Signed::max());
    EXPECT_EQ(NSNumber::numberWithDouble(9223372036854775808.0)->integerValue(), Signed::max());
    EXPECT_EQ(NSNumber::numberWithDouble(-1e300)->integerValue(), Signed::min());
    EXPECT_EQ(NSNumber::numberWithDouble(-Infinity)->integerValue(), Signed::min());
    EXPECT_EQ(NSNumber::numberWithDouble(NotANumber)->integerValue(), 0);
    EXPECT_EQ(NSNumber::numberWithDouble(-2.9)->integerValue(), -2);
    EXPECT_EQ(NSNumber::numberWithBool(true)->integerValue(), 1);
}

TEST(NSNumber, SaturatesAtTheLimitsOfAnUnsignedNumber) {
    EXPECT_EQ(NSNumber::numberWithInteger(-1)->unsignedIntegerValue(), 0U);
    EXPECT_EQ(NSNumber::numberWithDouble(-0.5)->unsignedIntegerValue(), 0U);
    EXPECT_EQ(NSNumber::numberWithDouble(18446744073709551616.0)->unsignedIntegerValue(),
              Unsigned::max());
    EXPECT_EQ(NSNumber::numberWithDouble(Infinity)->unsignedIntegerValue(), Unsigned::max());
    EXPECT_EQ(NSNumber::numberWithDouble(NotANumber)->unsignedIntegerValue(), 0U);
    EXPECT_EQ(NSNumber::numberWithDouble(2.9)->unsignedIntegerValue(), 2U);
    EXPECT_EQ(NSNumber::numberWithBool(true)->unsignedIntegerValue(), 1U);
}

TEST(NSNumber, ReadsAsATruthValueAndAsADouble) {
    EXPECT_TRUE(NSNumber::numberWithDouble(0.1)->boolValue());
    EXPECT_TRUE(NSNumber::numberWithInteger(-1)->boolValue());
    EXPECT_FALSE(NSNumber::numberWithDouble(-0.0)->boolValue());
    EXPECT_FALSE(NSNumber::numberWithUnsignedInteger(0)->boolValue());
    EXPECT_EQ(NSNumber::numberWithBool(true)->doubleValue(), 1.0);
    EXPECT_EQ(NSNumber::numberWithInteger(-3)->doubleValue(), -3.0);
}

TEST(NSNumber, DescribesItselfAsTheShortestTextThatReadsBack) {
    EXPECT_EQ(NSNumber::numberWithBool(true)->description(), "1");
    EXPECT_EQ(NSNumber::numberWithBool(false)->description(), "0");
    EXPECT_EQ(NSNumber::numberWithInteger(Signed::min())->description(), "-9223372036854775808");
    EXPECT_EQ(NSNumber::numberWithUnsignedInteger(Unsigned::max())->description(),
              "18446744073709551615");
    EXPECT_EQ(NSNumber::numberWithDouble(0.1)->description(), "0.1");
    EXPECT_EQ(NSNumber::numberWithDouble(2)->description(), "2");
}

TEST(NSNumber, IsItsOwnCopy) {
    const auto number = NSNumber::numberWithInteger(1);
    EXPECT_EQ(number->copy(), number);
}

} // namespace
} // namespace orvo
