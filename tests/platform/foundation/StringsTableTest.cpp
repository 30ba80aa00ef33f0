#include "platform/foundation/StringsTable.h"

#include "platform/foundation/FolderBundle.h"
#include "platform/foundation/LocalizedFormat.h"
#include "platform/foundation/Text.h"
#include "support/LogCapture.h"
#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <fstream>
#include <iterator>
#include <set>

namespace orvo {
namespace {

TEST(StringsTable, ReadsEntriesCommentsEscapesAndPluralForms) {
    const auto table =
        StringsTable::parse("/* a */ \"k\" = \"one \\\"two\\\"\\n\\\\\";\n"
                            "\"p\" = { one = \"%lu line\"; other = \"%lu lines\"; };",
                            nullptr);
    ASSERT_TRUE(table);
    EXPECT_EQ(table->text("k"), "one \"two\"\n\\");
    const auto forms = PluralForms::unpacked(*table->text("p"));
    ASSERT_TRUE(forms);
    EXPECT_EQ(*forms, (PluralForms::Forms{{"one", "%lu line"}, {"other", "%lu lines"}}));
    EXPECT_FALSE(table->text("missing"));
    EXPECT_FALSE(PluralForms::unpacked("plain"));
}

TEST(StringsTable, SaysTheLineOfABadEntry) {
    std::string problem;
    EXPECT_FALSE(StringsTable::parse("\"a\" = \"b\";\n\"c\" = ;\n", &problem));
    EXPECT_EQ(problem.substr(0, 7), "line 2:");
    EXPECT_FALSE(StringsTable::parse("\"a\" = \"b\"", &problem));
    EXPECT_FALSE(
        StringsTable::parse("\"a\" = { one = \"x\"; };", &problem)); // no form for the rest
    EXPECT_FALSE(StringsTable::parse("\"a", &problem));
}

class BundleTest : public ::testing::Test {
protected:
    void write(const char* path, const char* text) {
        const auto file = folder.path() / path;
        std::filesystem::create_directories(file.parent_path());
        std::ofstream(file) << text;
    }
    std::string text(const char* tag, const char* key, const char* value = "none") {
        const auto scope = Text::locale().overrideWith(tag);
        return NSBundle::bundleWithPath(folder.path())
            ->localizedStringForKey_value_table(key, value, std::nullopt);
    }

    testing::TemporaryFolder folder;
};

TEST_F(BundleTest, TakesTheBestLanguageThenEnglishThenTheValue) {
    write("en.lproj/Localizable.strings", "\"a\" = \"english a\"; \"b\" = \"english b\";");
    write("de.lproj/Localizable.strings", "\"a\" = \"deutsch a\";");
    EXPECT_EQ(text("de-AT", "a"), "deutsch a");
    EXPECT_EQ(text("de", "b"), "english b");
    EXPECT_EQ(text("fr", "a"), "english a");
    EXPECT_EQ(text("de", "c"), "none");
    EXPECT_EQ(text("de", "c", ""), "c");
}

TEST_F(BundleTest, UnreadableTableIsSaidOnceAndCountsAsEmpty) {
    write("en.lproj/Localizable.strings", "nonsense");
    const testing::LogCapture log;
    const auto scope = Text::locale().overrideWith("en");
    const auto bundle = NSBundle::bundleWithPath(folder.path());
    EXPECT_EQ(bundle->localizedStringForKey_value_table("a", "none", std::nullopt), "none");
    EXPECT_EQ(bundle->localizedStringForKey_value_table("b", "none", std::nullopt), "none");
    EXPECT_EQ(log.records().size(), 1U);
}

TEST(LanguagesToTry, GoesFromTheWholeTagToEnglish) {
    EXPECT_EQ(languagesToTry("zh-Hant-TW"),
              (std::vector<std::string>{"zh-Hant-TW", "zh-Hant", "zh", "en"}));
    EXPECT_EQ(languagesToTry("en-GB"), (std::vector<std::string>{"en-GB", "en"}));
    EXPECT_EQ(languagesToTry(""), (std::vector<std::string>{"en"}));
}

/// The tables that the program ships.
class ShippedTexts : public ::testing::TestWithParam<const char*> {
protected:
    static StringsTable table(const std::string& language) {
        std::ifstream file(std::string(ORVO_TEST_RESOURCES) + "/" + language +
                           ".lproj/Localizable.strings");
        const std::string text{std::istreambuf_iterator<char>(file), {}};
        std::string problem;
        const auto parsed = StringsTable::parse(text, &problem);
        EXPECT_TRUE(parsed) << problem;
        return parsed.value_or(StringsTable());
    }
};

TEST_P(ShippedTexts, HaveEveryKeyOfEnglish) {
    const auto english = table("en");
    const auto translated = table(GetParam());
    EXPECT_EQ(english.texts().size(), 19U);
    for (const auto& [key, text] : english.texts()) {
        ASSERT_TRUE(translated.text(key)) << key;
        EXPECT_EQ(PluralForms::unpacked(text).has_value(),
                  PluralForms::unpacked(*translated.text(key)).has_value())
            << key;
    }
    EXPECT_EQ(translated.texts().size(), english.texts().size());
}

TEST_P(ShippedTexts, HaveAFormForEveryNumber) {
    const auto scope = Text::locale().overrideWith(GetParam());
    const auto translated = table(GetParam());
    for (const auto& [key, text] : translated.texts()) {
        const auto forms = PluralForms::unpacked(text);
        if (!forms)
            continue;
        std::set<std::string> used;
        for (std::uint64_t number = 0; number <= 120; ++number) {
            // A form that shows its own name tells which one the number takes.
            auto named = *forms;
            for (auto& [category, form] : named)
                form = category;
            used.insert(localizedStringWithFormat(PluralForms::packed(named), {number}));
            EXPECT_FALSE(localizedStringWithFormat(text, {number}).empty()) << key;
        }
        for (const auto& [category, form] : *forms) {
            EXPECT_TRUE(category == "other" || used.contains(category))
                << key << " has a form that no number takes: " << category;
        }
    }
}

INSTANTIATE_TEST_SUITE_P(Languages, ShippedTexts, ::testing::Values("en", "de", "pl", "ja", "ar"));

TEST(ShippedTexts, ReadAsAnEditorOfTheLanguageWouldWriteThem) {
    const auto shown = [](const char* language, const char* key, std::uint64_t number) {
        const auto scope = Text::locale().overrideWith(language);
        return localizedStringWithFormat(
            NSBundle::bundleWithPath(ORVO_TEST_RESOURCES)
                ->localizedStringForKey_value_table(key, "missing", std::nullopt),
            {number});
    };
    EXPECT_EQ(shown("en", "TransitWidget_Summary_advisory_count", 2), "2 advisories");
    EXPECT_EQ(shown("en", "TransitWidget_GoodService_Overflow_SecondaryText", 1), "1 line");
    EXPECT_EQ(shown("de", "TransitWidget_advisory_overflow_title", 3), "3 weitere Meldungen");
    EXPECT_EQ(shown("pl", "TransitWidget_Summary_advisory_count", 5), "5 komunikatów");
    EXPECT_EQ(shown("pl", "TransitWidget_Summary_advisory_count", 3), "3 komunikaty");
    EXPECT_EQ(shown("en", "Transit_Incident_Not_Displayed_Incidents", 3), "+3");
    EXPECT_EQ(shown("ar", "Transit_Incident_Not_Displayed_Incidents", 2), "اثنان آخران");
    EXPECT_EQ(shown("ja", "TransitWidget_AdvisoriesOverflow_SecondaryText", 4), "4路線");
    EXPECT_EQ(shown("ar", "TransitWidget_Summary_advisory_count", 2), "تنبيهان");
}

} // namespace
} // namespace orvo
