#include "platform/foundation/LocalizedFormat.h"

#include "platform/foundation/StringsTable.h"
#include "platform/foundation/Text.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

auto language(const char* tag) {
    return Text::locale().overrideWith(tag);
}

TEST(LocalizedFormat, FillsInOrderAndByPosition) {
    const auto scope = language("en");
    EXPECT_EQ(localizedStringWithFormat("%@: %@", {"U1", "closed"}), "U1: closed");
    EXPECT_EQ(localizedStringWithFormat("%2$@ on %1$@", {"U1", "closed"}), "closed on U1");
    EXPECT_EQ(localizedStringWithFormat("%lu of %ld, %d%%",
                                        {std::uint64_t{1}, std::int64_t{-2}, std::int64_t{3}}),
              "1 of -2, 3%");
}

TEST(LocalizedFormat, ArgumentsAreNeverReadAsFormats) {
    const auto scope = language("en");
    EXPECT_EQ(localizedStringWithFormat("%@: %@", {"100 %@", "%lu %2$@"}), "100 %@: %lu %2$@");
}

TEST(LocalizedFormat, MissingValuesAndLonePercentSignsAreHarmless) {
    const auto scope = language("en");
    EXPECT_EQ(localizedStringWithFormat("%@ and %@", {"U1"}), "U1 and ");
    EXPECT_EQ(localizedStringWithFormat("%9$@", {"U1"}), "");
    EXPECT_EQ(localizedStringWithFormat("50 % off %", {}), "50 % off %");
    EXPECT_EQ(localizedStringWithFormat("%1$", {"a"}), "%1$");
}

TEST(LocalizedFormat, WritesNumbersAsTheLanguageDoes) {
    const auto german = language("de");
    EXPECT_EQ(localizedStringWithFormat("%lu", {std::uint64_t{1234567}}), "1.234.567");
    const auto english = language("en");
    EXPECT_EQ(localizedStringWithFormat("%lu", {~std::uint64_t{0}}), "18,446,744,073,709,551,615");
    const auto egypt = language("ar-EG");
    EXPECT_EQ(localizedStringWithFormat("%lu", {std::uint64_t{12}}), "١٢");
}

TEST(LocalizedFormat, TakesThePluralFormOfTheFirstNumberInTheLanguage) {
    const auto format = PluralForms::packed({{"zero", "zero"},
                                             {"one", "one"},
                                             {"two", "two"},
                                             {"few", "few"},
                                             {"many", "many"},
                                             {"other", "other"}});
    const auto form = [&](const char* tag, std::uint64_t number) {
        const auto scope = language(tag);
        return localizedStringWithFormat(format, {"a name", number});
    };
    EXPECT_EQ(form("en", 0), "other");
    EXPECT_EQ(form("en", 1), "one");
    EXPECT_EQ(form("pl", 2), "few");
    EXPECT_EQ(form("pl", 5), "many");
    EXPECT_EQ(form("pl", 22), "few");
    EXPECT_EQ(form("ja", 1), "other");
    EXPECT_EQ(form("ar", 0), "zero");
    EXPECT_EQ(form("ar", 2), "two");
    EXPECT_EQ(form("ar", 3), "few");
    EXPECT_EQ(form("ar", 11), "many");
    EXPECT_EQ(form("ar", 100), "other");
}

TEST(LocalizedFormat, MissingFormFallsBackToOther) {
    const auto scope = language("ar");
    EXPECT_EQ(localizedStringWithFormat(PluralForms::packed({{"other", "%lu lines"}}),
                                        {std::uint64_t{1}}),
              "١ lines");
}

TEST(LocalizedFormat, ListsAreSeparatedInTheMiddleWayWithoutAConjunction) {
    const std::vector<std::string> names{"U1", "U2", "U3"};
    {
        const auto scope = language("en");
        EXPECT_EQ(localizedCommaDelimitedList(names), "U1, U2, U3");
        EXPECT_EQ(localizedCommaDelimitedList({"U1"}), "U1");
        EXPECT_EQ(localizedCommaDelimitedList({}), "");
    }
    {
        const auto scope = language("ja");
        EXPECT_EQ(localizedCommaDelimitedList(names), "U1、U2、U3");
    }
    const auto scope = language("de");
    EXPECT_EQ(localizedCommaDelimitedList(names), "U1, U2, U3");
}

} // namespace
} // namespace orvo
