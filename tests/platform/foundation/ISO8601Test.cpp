#include "platform/foundation/ISO8601.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace orvo {
namespace {

TEST(ISO8601, WritesWholeSecondsInUTC) {
    EXPECT_EQ(ISO8601::string(1721784520), "2024-07-24T01:28:40Z");
    EXPECT_EQ(ISO8601::string(0), "1970-01-01T00:00:00Z");
    EXPECT_EQ(ISO8601::string(951782400), "2000-02-29T00:00:00Z");
}

TEST(ISO8601, CutsFractionsTowardsThePast) {
    EXPECT_EQ(ISO8601::string(0.999), "1970-01-01T00:00:00Z");
    EXPECT_EQ(ISO8601::string(-0.001), "1969-12-31T23:59:59Z");
}

TEST(ISO8601, WritesYearsOfFourDigitsAndTheBareNumberBeyond) {
    EXPECT_EQ(ISO8601::string(-62167219200.0), "0000-01-01T00:00:00Z");
    EXPECT_EQ(ISO8601::string(253402300799.5), "9999-12-31T23:59:59Z");
    EXPECT_EQ(ISO8601::string(253402300800.0), "253402300800");
    EXPECT_EQ(ISO8601::string(-62167219200.5), "-62167219200.5");
    EXPECT_EQ(ISO8601::string(std::numeric_limits<double>::infinity()), "inf");
    EXPECT_EQ(ISO8601::string(std::numeric_limits<double>::quiet_NaN()), "nan");
}

TEST(ISO8601, ReadsWhatItWrites) {
    for (const double seconds : {0.0, 1721784520.0, -86401.0, 253402300799.0, -62167219200.0})
        EXPECT_EQ(ISO8601::parse(ISO8601::string(seconds)), seconds);
}

TEST(ISO8601, ReadsOtherWaysOfWritingTheSameMoment) {
    for (const char* text : {"2024-07-24T01:28:40Z",
                             "2024-07-24t01:28:40z",
                             "2024-07-24 01:28:40",
                             "2024-07-24T03:28:40+02:00",
                             "2024-07-24T03:28:40+0200",
                             "2024-07-24T03:28:40+02",
                             "2024-07-23T15:58:40-09:30",
                             "2024-07-24T01:28:40.000Z"})
        EXPECT_EQ(ISO8601::parse(text), 1721784520.0) << text;
    EXPECT_EQ(ISO8601::parse("2024-07-24T01:28Z"), 1721784480.0);
    EXPECT_EQ(ISO8601::parse("2024-07-24"), 1721779200.0);
}

TEST(ISO8601, ReadsFractions) {
    EXPECT_NEAR(ISO8601::parse("1970-01-01T00:00:01.25Z").value(), 1.25, 1e-12);
    EXPECT_NEAR(ISO8601::parse("1970-01-01T00:00:00.999999999Z").value(), 0.999999999, 1e-12);
    EXPECT_TRUE(std::isfinite(
        ISO8601::parse("1970-01-01T00:00:00." + std::string(5000, '9') + "Z").value()));
}

TEST(ISO8601, AnswersNothingForAnythingElse) {
    for (const char* text : {"",
                             "2024",
                             "2024-7-24",
                             "2024-02-30",
                             "2023-02-29",
                             "2024-13-01",
                             "2024-00-10",
                             "2024-07-24T",
                             "2024-07-24T24:00:00Z",
                             "2024-07-24T23:60:00Z",
                             "2024-07-24T23:59:60Z",
                             "2024-07-24T01:28:40.Z",
                             "2024-07-24T01:28:40+24:00",
                             "2024-07-24T01:28:40+02:60",
                             "2024-07-24T01:28:40+02:",
                             "2024-07-24T01:28:40+2",
                             "2024-07-24T01:28:40ZZ",
                             "2024-07-24T01:28:40Z ",
                             " 2024-07-24",
                             "+024-07-24",
                             "2024/07/24"})
        EXPECT_EQ(ISO8601::parse(text), std::nullopt) << text;
}

TEST(ISO8601, AnswersNothingForACutOffTime) {
    const std::string whole = "2024-07-24T01:28:40+02:00";
    for (std::size_t length = 0; length < whole.size(); ++length) {
        const bool complete = length == 10 || length == 16 || length == 19 || length == 22;
        EXPECT_EQ(ISO8601::parse(whole.substr(0, length)).has_value(), complete) << length;
    }
}

} // namespace
} // namespace orvo
