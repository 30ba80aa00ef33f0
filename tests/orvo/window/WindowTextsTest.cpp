#include "orvo/window/WindowTexts.h"

#include "orvo/window/WindowWorld.h"
#include "platform/foundation/StringsTable.h"

#include <iterator>

namespace orvo {
namespace {

using WindowTextsTest = testing::WindowTest;

TEST_F(WindowTextsTest, APeriodIsToldWithTheClockOfItsPlace) {
    const auto period = [](std::optional<double> start, std::optional<double> end) {
        return WindowTexts::period(start, end, Now, "Europe/Berlin");
    };
    EXPECT_EQ(period(Now + 3600, Now + 7200), "6:06 PM – 7:06 PM");
    EXPECT_EQ(period(Now + 3600, std::nullopt), "From 6:06 PM");
    EXPECT_EQ(period(Now - 3600, Now + 3600), "Since 4:06 PM, until 6:06 PM");
    EXPECT_EQ(period(Now - 3600, std::nullopt), "Since 4:06 PM");
    EXPECT_EQ(period(std::nullopt, Now + 3600), "Until 6:06 PM");
    EXPECT_EQ(period(std::nullopt, std::nullopt), "Until further notice");
}

TEST_F(WindowTextsTest, ASpeakerOfAnotherLanguageReadsIt) {
    const auto german = Text::locale().overrideWith("de");
    EXPECT_EQ(WindowTexts::incidents(2), "2 Meldungen");
    EXPECT_EQ(WindowTexts::period(Now - 3600, Now + 3600, Now, "Europe/Berlin"),
              "Seit 16:06, bis 18:06");
    EXPECT_EQ(WindowTexts::text("Removed", "U1"), "U1 wurde entfernt.");
}

/// The tables that the program ships.
class ShippedWindowTexts : public ::testing::TestWithParam<const char*> {
protected:
    static StringsTable table(const std::string& language) {
        std::ifstream file(std::string(ORVO_TEST_RESOURCES) + "/" + language +
                           ".lproj/Windows.strings");
        const std::string text{std::istreambuf_iterator<char>(file), {}};
        std::string problem;
        const auto parsed = StringsTable::parse(text, &problem);
        EXPECT_TRUE(parsed) << problem;
        return parsed.value_or(StringsTable());
    }
};

TEST_P(ShippedWindowTexts, HaveEveryKeyOfEnglish) {
    const auto english = table("en");
    const auto translated = table(GetParam());
    EXPECT_GT(english.texts().size(), 20U);
    EXPECT_EQ(translated.texts().size(), english.texts().size());
    for (const auto& [key, text] : english.texts()) {
        ASSERT_TRUE(translated.text(key)) << key;
        EXPECT_EQ(PluralForms::unpacked(text).has_value(),
                  PluralForms::unpacked(*translated.text(key)).has_value())
            << key;
    }
}

INSTANTIATE_TEST_SUITE_P(Languages,
                         ShippedWindowTexts,
                         ::testing::Values("en", "de", "pl", "ja", "ar"));

} // namespace
} // namespace orvo
