#include "platform/foundation/LogFormat.h"

#include "platform/foundation/NSString.h"

#include <gtest/gtest.h>

#include <array>
#include <cstdint>
#include <limits>
#include <sstream>

namespace orvo {
namespace {

template <class... Arguments>
LogText formatted(std::string_view format, const Arguments&... arguments) {
    const std::array<LogArgument, sizeof...(Arguments)> values{LogArgument(arguments)...};
    return formatLog(format, values);
}
template <class... Arguments>
std::string message(std::string_view format, const Arguments&... arguments) {
    return formatted(format, arguments...).message;
}

TEST(LogFormat, FillsInNumbersOfEverySize) {
    EXPECT_EQ(message("%d %i %u %lu %ld %llu %lld %zu",
                      -1,
                      2,
                      3U,
                      std::numeric_limits<std::uint64_t>::max(),
                      std::numeric_limits<std::int64_t>::min(),
                      4ULL,
                      -5LL,
                      std::size_t{6}),
              "-1 2 3 18446744073709551615 -9223372036854775808 4 -5 6");
    EXPECT_EQ(message("%x %X %o %lx %c", 255, 255, 8, std::uint64_t{0xdeadbeefcafe}, 'z'),
              "ff FF 10 deadbeefcafe z");
}

TEST(LogFormat, FillsInFractions) {
    EXPECT_EQ(message("%.2f %f %.0f %g %e", 3.14159, 1.5, 2.5, 0.5, 1500.0),
              "3.14 1.500000 2 0.5 1.500000e+03");
    EXPECT_EQ(message("%.1f", -std::numeric_limits<double>::infinity()), "-inf");
    EXPECT_EQ(message("%f", std::numeric_limits<double>::max()).size(), 309U + 7U);
}

TEST(LogFormat, FillsInTextAndObjects) {
    EXPECT_EQ(message("%s %@ %@", "c", std::string("cpp"), NSString::string("object")),
              "c cpp object");
    EXPECT_EQ(message("%@ %s", nullptr, std::shared_ptr<NSString>()), "(null) (null)");
    EXPECT_EQ(message("<%@>", std::string("a\0b", 3)), std::string("<a\0b>", 5));
}

TEST(LogFormat, ShowsTheAddressOfAnObject) {
    const auto object = NSString::string("text");
    std::ostringstream address;
    address << static_cast<const NSObject*>(object.get());
    EXPECT_EQ(message("%p", object), address.str());
    EXPECT_EQ(message("%p", 255), "0xff");
}

TEST(LogFormat, PadsAsPrintfDoes) {
    EXPECT_EQ(message("[%5d|%-5d|%05d|%+d|% d]", 42, 42, 42, 42, 42),
              "[   42|42   |00042|+42| 42]");
    EXPECT_EQ(message("[%5s|%-5s|%.2s]", "abc", "abc", "abc"), "[  abc|abc  |ab]");
    EXPECT_EQ(message("[%*d|%.*f|%*d]", 4, 7, 1, 2.25, -4, 7), "[   7|2.2|7   ]");
    EXPECT_EQ(message("%#x", 255), "0xff");
    EXPECT_EQ(message("%999999999d", 1).size(), 1000U);
}

TEST(LogFormat, HidesOnlyWhatIsMarkedPrivate) {
    const auto text = formatted(
        "%{private}@ %{public}@ %{private, mask.hash}lu %@ %{sensitive}s", "a", "b", 3UL, "d", "e");
    EXPECT_EQ(text.message, "a b 3 d e");
    EXPECT_EQ(text.redacted, "<private> b <private> d <private>");
}

TEST(LogFormat, SaysWhichValueIsMissing) {
    EXPECT_EQ(message("%@ and %lu", "one"), "one and (missing)");
    EXPECT_EQ(message("%*d"), "(missing)");
    EXPECT_EQ(formatted("%{private}@").redacted, "<private>");
}

TEST(LogFormat, LeavesOutAValueTooMany) {
    EXPECT_EQ(message("%d.", 1, 2, "three"), "1.");
    EXPECT_EQ(message("none", 1), "none");
}

TEST(LogFormat, ShowsAValueOfTheWrongKindAsWhatItIs) {
    EXPECT_EQ(message("%d", "text"), "text");
    EXPECT_EQ(message("%lu", -1), "-1");
    EXPECT_EQ(message("%d", 2.5), "2.5");
    EXPECT_EQ(message("%.2f", 7), "7");
    EXPECT_EQ(message("%@ %s", 7, 2.5), "7 2.5");
    EXPECT_EQ(message("%d %.1f", NSString::string("a"), NSString::string("bcd")), "a bcd");
}

TEST(LogFormat, LeavesWhatIsNoPlaceholderAsItStands) {
    EXPECT_EQ(message("100%% of %d%%", 5), "100% of 5%");
    EXPECT_EQ(message("50% "), "50% ");
    EXPECT_EQ(message("%"), "%");
    EXPECT_EQ(message("%y %d", 1), "%y 1");
    EXPECT_EQ(message("%{private"), "%{private");
    EXPECT_EQ(message("%{private}"), "%{private}");
    EXPECT_EQ(message("%*y %d", 1), "%*y 1");
    EXPECT_EQ(message("%l"), "%l");
    EXPECT_EQ(message(""), "");
}

TEST(LogFormat, DoesNotReadPlaceholdersInValues) {
    EXPECT_EQ(message("%@ %@", "%d%n", "{}"), "%d%n {}");
}

} // namespace
} // namespace orvo
